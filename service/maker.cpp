#include "service/maker.h"

#include <algorithm>

#include "service/plain_text.h"

namespace wp {
namespace {

constexpr std::uint8_t kVendorElement = 221;

char lower(char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c;
}

bool beginsWith(const std::string& text, const std::string& prefix) {
    return !prefix.empty() && text.size() >= prefix.size() &&
           std::equal(prefix.begin(), prefix.end(), text.begin(),
                      [](char a, char b) { return lower(a) == lower(b); });
}

std::string textFrom(Bytes body) {
    return plainText({reinterpret_cast<const char*>(body.data()), body.size()});
}

/// All bodies of WPS elements, one after the other.
std::vector<std::uint8_t> wpsAttributes(Bytes elements) {
    std::vector<std::uint8_t> attributes;
    forEachElement(elements, [&](std::uint8_t identifier, Bytes body) {
        if (identifier != kVendorElement || body.size() < 4 || bigEndian32(body, 0) != 0x0050F204) return;
        attributes.insert(attributes.end(), body.begin() + 4, body.end());
    });
    return attributes;
}

template <std::size_t N>
bool startsWith(const MacAddress& address, const std::array<std::uint8_t, N>& prefix) {
    return std::equal(prefix.begin(), prefix.end(), address.begin());
}

bool isMaker(const std::string& manufacturer, const Vendors::BaseStation& vendor) {
    return std::any_of(vendor.manufacturers.begin(), vendor.manufacturers.end(),
                       [&](const std::string& name) { return beginsWith(manufacturer, name); });
}

bool hasElement(Bytes elements, const Vendors::Hotspot::VendorElement& wanted) {
    bool found = false;
    forEachElement(elements, [&](std::uint8_t identifier, Bytes body) {
        if (identifier != kVendorElement || body.size() < 3) return;
        if (!std::equal(wanted.prefix.begin(), wanted.prefix.end(), body.begin())) return;
        found |= !wanted.type || (body.size() > 3 && body[3] == *wanted.type);
    });
    return found;
}

}  // namespace

WpsDescription decodeWps(Bytes elements) {
    WpsDescription description;
    const auto attributes = wpsAttributes(elements);
    Bytes rest = attributes;
    while (rest.size() >= 4) {
        const unsigned type = rest[0] << 8U | rest[1];
        const std::size_t length = static_cast<std::size_t>(rest[2] << 8U | rest[3]);
        if (length > rest.size() - 4) break;
        const Bytes body = rest.subspan(4, length);
        switch (type) {
            case 0x1011:
                description.deviceName = textFrom(body);
                break;
            case 0x1021:
                description.manufacturer = textFrom(body);
                break;
            case 0x1023:
                description.modelName = textFrom(body);
                break;
            case 0x1024:
                description.modelNumber = textFrom(body);
                break;
            default:
                break;
        }
        rest = rest.subspan(4 + length);
    }
    return description;
}

Outcome isVendorBaseStation(const AccessPoint& accessPoint, const Known<RouterDescription>& router,
                            const Vendors::BaseStation& vendor) {
    if (vendor.manufacturers.empty() && vendor.prefixes.empty())
        return failure(Reason::badConfiguration, "no maker of base stations is configured");
    const WpsDescription wps = decodeWps(accessPoint.elements);
    const bool ours =
        isMaker(wps.manufacturer, vendor) || (router && isMaker(router->manufacturer, vendor)) ||
        std::any_of(vendor.prefixes.begin(), vendor.prefixes.end(),
                    [&](const VendorPrefix& prefix) { return startsWith(accessPoint.address, prefix); });
    if (ours && !wps.modelName.empty()) return works(true, {{"MarlixModelName", wps.modelName}});
    if (ours && router && !router->modelName.empty())
        return works(true, {{"MarlixModelName", router->modelName}});
    if (ours) return works(true);
    const bool named = !wps.manufacturer.empty() || (router && !router->manufacturer.empty());
    if (named || vendor.manufacturers.empty()) return works(false);
    if (!router) return router.error();
    return failure(Reason::unsupported, "neither the access point nor the router says who made it");
}

HotspotMatches hotspotMatches(const AccessPoint& accessPoint, const Known<std::string>& leaseText,
                              const Vendors::Hotspot& vendor) {
    HotspotMatches matches;
    matches.addressPrefix =
        std::any_of(vendor.addressPrefixes.begin(), vendor.addressPrefixes.end(), [&](const auto& prefix) {
            return !prefix.empty() && prefix.size() <= accessPoint.address.size() &&
                   std::equal(prefix.begin(), prefix.end(), accessPoint.address.begin());
        });
    matches.element = std::any_of(vendor.elements.begin(), vendor.elements.end(), [&](const auto& wanted) {
        return hasElement(accessPoint.elements, wanted) ||
               (accessPoint.beaconElements && hasElement(*accessPoint.beaconElements, wanted));
    });
    matches.leaseText =
        leaseText &&
        std::any_of(vendor.leaseTexts.begin(), vendor.leaseTexts.end(), [&](const std::string& text) {
            return !text.empty() && leaseText->find(text) != text.npos;
        });
    return matches;
}

Outcome isVendorHotspot(const AccessPoint& accessPoint, const Known<std::string>& leaseText,
                        const Vendors::Hotspot& vendor) {
    if (vendor.elements.empty() && vendor.addressPrefixes.empty() && vendor.leaseTexts.empty())
        return failure(Reason::badConfiguration, "no sign of a personal hotspot is configured");
    const bool found = hotspotMatches(accessPoint, leaseText, vendor).any();
    if (!found && !leaseText && !vendor.leaseTexts.empty()) return leaseText.error();
    return problem(found);
}

}  // namespace wp
