#pragma once

#include <string_view>

#include "service/elements.h"

namespace wp {

/// What an access point advertises of its security, as bits.
struct SecuritySuites {
    /// Kinds of key management, from both the RSN and the WPA element.
    enum KeyManagement : std::uint16_t {
        kEnterprise = 1,        ///< 802.1X
        kEnterpriseSha256 = 2,  ///< 802.1X with SHA-256, of WPA3 where frame protection is required
        kEnterpriseStrong = 4,  ///< 802.1X with 192 bits or SHA-384, WPA3 only
        kPreSharedKey = 8,
        kSae = 16,  ///< WPA3's password
        kOwe = 32,  ///< encrypted without a password
        kOtherKeyManagement = 64,
    };
    enum Cipher : std::uint8_t { kWep = 1, kTkip = 2, kCcmpOrBetter = 4, kOtherCipher = 8 };

    bool privacy = false;        ///< the capability's privacy bit
    bool rsn = false;            ///< an RSN element is there
    bool wpa = false;            ///< a WPA element is there
    bool wapi = false;           ///< a WAPI element is there
    bool onlineSignUp = false;   ///< an online sign-up network, encrypted in a way of its own
    bool oweTransition = false;  ///< names an encrypted twin
    bool malformed = false;  ///< a security element, or the elements before it, ended too early; incomplete
    bool frameProtectionRequired = false;
    std::uint16_t keyManagement = 0;     ///< of the RSN element and those that override it
    std::uint16_t wpaKeyManagement = 0;  ///< of the WPA element
    std::uint8_t pairwise = 0;           ///< of all elements
    std::uint8_t rsnPairwise = 0;        ///< of the RSN element and those that override it
    std::uint8_t group = 0;              ///< of all elements
};

/// Reads capability bits and security elements. *Any* thread.
SecuritySuites decodeSecurity(std::uint16_t capability, const Elements& elements);

/// The security in the words of the result document.
enum class Security {
    open,
    owe,
    oweTransition,
    wep,
    wpaPersonal,
    mixedWpaWpa2Personal,
    wpa2Personal,
    mixedWpa2Wpa3Personal,
    wpa3Personal,
    wpaEnterprise,
    mixedWpaWpa2Enterprise,
    wpa2Enterprise,
    mixedWpa2Wpa3Enterprise,
    wpa3Enterprise,
    unknown,
};

/// The kinds of security that do not mix in one network. A password with SAE beside it is one kind.
enum class SecurityClass { open, owe, wep, personal, enterprise, unknown };

/// Enterprise comes before SAE, and SAE before a shared password, where several are offered. *Any* thread.
Security securityOf(const SecuritySuites& suites);
SecurityClass classOf(Security security);
/// The document's word, for example "WPA2/WPA3 Personal".
std::string_view nameOf(Security security);

}  // namespace wp
