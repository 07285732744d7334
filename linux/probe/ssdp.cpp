#include "linux/probe/ssdp.h"

#include <algorithm>

#include "linux/probe/web_place.h"
#include "linux/probe/xml_text.h"
#include "service/plain_text.h"

namespace wp {
namespace {

bool equalWithoutCase(std::string_view a, std::string_view b) {
    const auto lower = [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c; };
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                      [lower](char x, char y) { return lower(x) == lower(y); });
}

std::string_view trimmed(std::string_view text) {
    const std::size_t start = text.find_first_not_of(" \t\r");
    if (start == text.npos) return {};
    return text.substr(start, text.find_last_not_of(" \t\r") - start + 1);
}

/// The type goes back to the router in a header: only what a type is made of may be in it.
bool knowsExternalAddress(const std::string& serviceType) {
    const bool plain = std::all_of(serviceType.begin(), serviceType.end(), [](char c) {
        return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == ':' ||
               c == '-' || c == '.' || c == '_';
    });
    return plain && (serviceType.starts_with("urn:schemas-upnp-org:service:WANIPConnection:") ||
                     serviceType.starts_with("urn:schemas-upnp-org:service:WANPPPConnection:"));
}

}  // namespace

std::string ssdpSearch() {
    return "M-SEARCH * HTTP/1.1\r\n"
           "HOST: 239.255.255.250:1900\r\n"
           "MAN: \"ssdp:discover\"\r\n"
           "MX: 1\r\n"
           "ST: urn:schemas-upnp-org:device:InternetGatewayDevice:1\r\n\r\n";
}

std::optional<std::string> locationFromSsdp(std::string_view message) {
    if (!message.starts_with("HTTP/1.1 200") && !message.starts_with("HTTP/1.0 200")) return std::nullopt;
    while (true) {
        const std::size_t end = message.find('\n');
        if (end == message.npos) return std::nullopt;
        message.remove_prefix(end + 1);
        const std::string_view line = message.substr(0, message.find('\n'));
        const std::size_t colon = line.find(':');
        if (colon == line.npos || !equalWithoutCase(trimmed(line.substr(0, colon)), "location")) continue;
        const std::string url(trimmed(line.substr(colon + 1)));
        const auto place = webPlace(url);
        return place && !place->secure ? std::optional(url) : std::nullopt;
    }
}

DeviceDescription readDeviceDescription(std::string_view xml) {
    DeviceDescription description;
    std::string serviceType, controlUrl;
    walkXml(xml, [&](const auto& path, const std::string& text) {
        const std::string_view name = path.back();
        const auto keepFirst = [&](std::string& place) {
            if (place.empty()) place = plainText(text);
        };
        // The outermost device comes first; those inside it have names of their own.
        if (name == "manufacturer") keepFirst(description.router.manufacturer);
        if (name == "modelName") keepFirst(description.router.modelName);
        if (name == "friendlyName") keepFirst(description.router.friendlyName);
        if (name == "URLBase") keepFirst(description.urlBase);
        if (path.size() < 2 || path[path.size() - 2] != "service") return;
        if (name == "serviceType") serviceType = text, controlUrl.clear();
        if (name == "controlURL") controlUrl = text;
        if (!knowsExternalAddress(serviceType) || controlUrl.empty() || !description.controlUrl.empty())
            return;
        description.controlUrl = controlUrl;
        description.serviceType = serviceType;
    });
    return description;
}

std::string externalAddressQuestion(std::string_view serviceType) {
    return "<?xml version=\"1.0\"?>\r\n"
           "<s:Envelope xmlns:s=\"http://schemas.xmlsoap.org/soap/envelope/\" "
           "s:encodingStyle=\"http://schemas.xmlsoap.org/soap/encoding/\"><s:Body>"
           "<u:GetExternalIPAddress xmlns:u=\"" +
           std::string(serviceType) + "\"/></s:Body></s:Envelope>\r\n";
}

std::optional<IPAddress> addressFromSoap(std::string_view xml) {
    std::optional<IPAddress> address;
    walkXml(xml, [&](const auto& path, const std::string& text) {
        if (path.back() == "NewExternalIPAddress" && !address) address = IPAddress::fromText(text);
    });
    return address && !address->unspecified() ? address : std::nullopt;
}

}  // namespace wp
