#include "service/security.h"

namespace wp {
namespace {

constexpr std::uint32_t kRsnVendor = 0x000FAC00;
constexpr std::uint32_t kWpaVendor = 0x0050F200;
constexpr std::uint16_t kPrivacyBit = 1 << 4;
constexpr std::uint16_t kFrameProtectionRequiredBit = 1 << 6;

std::uint8_t cipherOf(std::uint32_t suite) {
    switch (suite) {
        case kRsnVendor | 1:
        case kRsnVendor | 5:
        case kWpaVendor | 1:
        case kWpaVendor | 5:
            return SecuritySuites::kWep;
        case kRsnVendor | 2:
        case kWpaVendor | 2:
            return SecuritySuites::kTkip;
        case kRsnVendor | 4:   // CCMP-128
        case kRsnVendor | 8:   // GCMP-128
        case kRsnVendor | 9:   // GCMP-256
        case kRsnVendor | 10:  // CCMP-256
        case kWpaVendor | 4:
            return SecuritySuites::kCcmpOrBetter;
        default:
            return SecuritySuites::kOtherCipher;
    }
}

std::uint16_t keyManagementOf(std::uint32_t suite) {
    switch (suite) {
        case kRsnVendor | 1:
        case kRsnVendor | 3:
        case kWpaVendor | 1:
            return SecuritySuites::kEnterprise;
        case kRsnVendor | 5:
        case kRsnVendor | 11:
        case kRsnVendor | 14:
        case kRsnVendor | 16:
            return SecuritySuites::kEnterpriseSha256;
        case kRsnVendor | 12:
        case kRsnVendor | 13:
        case kRsnVendor | 15:
        case kRsnVendor | 17:
        case kRsnVendor | 22:
        case kRsnVendor | 23:
            return SecuritySuites::kEnterpriseStrong;
        case kRsnVendor | 2:
        case kRsnVendor | 4:
        case kRsnVendor | 6:
        case kRsnVendor | 19:
        case kRsnVendor | 20:
        case kWpaVendor | 2:
            return SecuritySuites::kPreSharedKey;
        case kRsnVendor | 8:
        case kRsnVendor | 9:
        case kRsnVendor | 24:
        case kRsnVendor | 25:
            return SecuritySuites::kSae;
        case kRsnVendor | 18:
            return SecuritySuites::kOwe;
        default:
            return SecuritySuites::kOtherKeyManagement;
    }
}

/// Reads the fields of a security element from front to back. An element may end between any two fields; then
/// the standard's defaults hold. It may not end within one.
class SuiteReader {
  public:
    explicit SuiteReader(Bytes bytes) : rest_(bytes) {}

    bool atEnd() const { return rest_.empty(); }
    bool malformed() const { return malformed_; }

    std::uint16_t number() {
        if (rest_.size() < 2) return fail();
        const std::uint16_t value = littleEndian16(rest_, 0);
        rest_ = rest_.subspan(2);
        return value;
    }

    std::uint32_t suite() {
        if (rest_.size() < 4) return fail();
        const std::uint32_t value = bigEndian32(rest_, 0);
        rest_ = rest_.subspan(4);
        return value;
    }

    /// A counted list of suites as bits.
    template <class Bits>
    auto list(Bits bitsOf) {
        decltype(bitsOf(0)) bits = 0;
        for (std::uint16_t left = number(); left > 0 && !malformed_; --left) {
            const std::uint32_t value = suite();
            if (!malformed_) bits = static_cast<decltype(bits)>(bits | bitsOf(value));
        }
        return bits;
    }

  private:
    std::uint16_t fail() {
        malformed_ = true;
        rest_ = {};
        return 0;
    }

    Bytes rest_;
    bool malformed_ = false;
};

/// The fields that the RSN and the WPA element have in common.
struct ElementSuites {
    std::uint8_t group = 0;
    std::uint8_t pairwise = 0;
    std::uint16_t keyManagement = 0;
    std::uint16_t capabilities = 0;
    bool malformed = false;
};

ElementSuites decodeSuites(Bytes body, std::uint8_t defaultCipher) {
    ElementSuites suites{defaultCipher, defaultCipher, SecuritySuites::kEnterprise, 0, false};
    SuiteReader reader(body);
    reader.number();  // the version; later versions keep the fields
    if (!reader.atEnd()) suites.group = cipherOf(reader.suite());
    if (!reader.atEnd()) suites.pairwise = reader.list(cipherOf);
    if (!reader.atEnd()) suites.keyManagement = reader.list(keyManagementOf);
    // What follows is the RSN element's alone, and the WPA element's own capabilities say nothing here.
    if (!reader.atEnd()) suites.capabilities = reader.number();
    suites.malformed = reader.malformed();
    return suites;
}

void addRsn(SecuritySuites& suites, const ElementSuites& rsn) {
    suites.keyManagement |= rsn.keyManagement;
    suites.rsnPairwise |= rsn.pairwise;
    suites.pairwise |= rsn.pairwise;
    suites.group |= rsn.group;
    suites.malformed |= rsn.malformed;
}

Security enterprise(const SecuritySuites& suites) {
    const std::uint16_t keys = suites.keyManagement;
    const bool wpa2 = keys & SecuritySuites::kEnterprise;
    const bool sha256 = keys & SecuritySuites::kEnterpriseSha256;
    const bool wpa3 = (keys & SecuritySuites::kEnterpriseStrong) ||
                      (sha256 && suites.frameProtectionRequired) || (sha256 && wpa2);
    if (wpa3) return wpa2 ? Security::mixedWpa2Wpa3Enterprise : Security::wpa3Enterprise;
    if (!wpa2 && !sha256) return Security::wpaEnterprise;
    return suites.wpa ? Security::mixedWpaWpa2Enterprise : Security::wpa2Enterprise;
}

Security personal(const SecuritySuites& suites) {
    const std::uint16_t keys = suites.keyManagement;
    const bool wpa2 = keys & SecuritySuites::kPreSharedKey;
    if (keys & SecuritySuites::kSae) return wpa2 ? Security::mixedWpa2Wpa3Personal : Security::wpa3Personal;
    if (!wpa2) return Security::wpaPersonal;
    return suites.wpa ? Security::mixedWpaWpa2Personal : Security::wpa2Personal;
}

}  // namespace

SecuritySuites decodeSecurity(std::uint16_t capability, const Elements& elements) {
    SecuritySuites suites;
    suites.privacy = capability & kPrivacyBit;
    // What broke off may have held one of them.
    suites.malformed = elements.malformed && !elements.rsn.present() && !elements.wpa.present();
    suites.wapi = elements.wapi.present();
    suites.onlineSignUp = elements.onlineSignUp.present();
    suites.oweTransition = elements.oweTransition.present();
    if (elements.rsn.present()) {
        const ElementSuites rsn = decodeSuites(elements.rsn.bytes(), SecuritySuites::kCcmpOrBetter);
        suites.rsn = true;
        addRsn(suites, rsn);
        suites.frameProtectionRequired = rsn.capabilities & kFrameProtectionRequiredBit;
        // What the override elements say is offered beside it.
        for (const Element* each : {&elements.rsnOverride, &elements.rsnOverride2})
            if (each->present()) addRsn(suites, decodeSuites(each->bytes(), SecuritySuites::kCcmpOrBetter));
    }
    if (elements.wpa.present()) {
        const ElementSuites wpa = decodeSuites(elements.wpa.bytes(), SecuritySuites::kTkip);
        suites.wpa = true;
        suites.wpaKeyManagement = wpa.keyManagement;
        suites.pairwise |= wpa.pairwise;
        suites.group |= wpa.group;
        suites.malformed |= wpa.malformed;
    }
    return suites;
}

Security securityOf(const SecuritySuites& suites) {
    constexpr std::uint16_t kAnyEnterprise =
        SecuritySuites::kEnterprise | SecuritySuites::kEnterpriseSha256 | SecuritySuites::kEnterpriseStrong;
    if (suites.malformed) return Security::unknown;
    if (!suites.rsn && !suites.wpa) {
        // WAPI and online sign-up set the privacy bit too, and are not WEP.
        if (suites.wapi || suites.onlineSignUp) return Security::unknown;
        if (suites.privacy) return Security::wep;
        return suites.oweTransition ? Security::oweTransition : Security::open;
    }
    const std::uint16_t keys = suites.keyManagement | suites.wpaKeyManagement;
    if (keys & kAnyEnterprise) return enterprise(suites);
    if (keys & (SecuritySuites::kSae | SecuritySuites::kPreSharedKey)) return personal(suites);
    return keys & SecuritySuites::kOwe ? Security::owe : Security::unknown;
}

SecurityClass classOf(Security security) {
    switch (security) {
        case Security::open:
        case Security::oweTransition:
            return SecurityClass::open;
        case Security::owe:
            return SecurityClass::owe;
        case Security::wep:
            return SecurityClass::wep;
        case Security::wpaPersonal:
        case Security::mixedWpaWpa2Personal:
        case Security::wpa2Personal:
        case Security::mixedWpa2Wpa3Personal:
        case Security::wpa3Personal:
            return SecurityClass::personal;
        case Security::wpaEnterprise:
        case Security::mixedWpaWpa2Enterprise:
        case Security::wpa2Enterprise:
        case Security::mixedWpa2Wpa3Enterprise:
        case Security::wpa3Enterprise:
            return SecurityClass::enterprise;
        case Security::unknown:
            break;
    }
    return SecurityClass::unknown;
}

std::string_view nameOf(Security security) {
    switch (security) {
        case Security::open:
            return "Open";
        case Security::owe:
            return "OWE";
        case Security::oweTransition:
            return "OWE Transition";
        case Security::wep:
            return "WEP";
        case Security::wpaPersonal:
            return "WPA Personal";
        case Security::mixedWpaWpa2Personal:
            return "WPA/WPA2 Personal";
        case Security::wpa2Personal:
            return "WPA2 Personal";
        case Security::mixedWpa2Wpa3Personal:
            return "WPA2/WPA3 Personal";
        case Security::wpa3Personal:
            return "WPA3 Personal";
        case Security::wpaEnterprise:
            return "WPA Enterprise";
        case Security::mixedWpaWpa2Enterprise:
            return "WPA/WPA2 Enterprise";
        case Security::wpa2Enterprise:
            return "WPA2 Enterprise";
        case Security::mixedWpa2Wpa3Enterprise:
            return "WPA2/WPA3 Enterprise";
        case Security::wpa3Enterprise:
            return "WPA3 Enterprise";
        case Security::unknown:
            break;
    }
    return "Unknown";
}

}  // namespace wp
