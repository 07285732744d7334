#include "linux/probe/portal_api.h"

#include "exchange/json_reader.h"
#include "linux/probe/web_place.h"
#include "service/plain_text.h"

namespace wp {

std::optional<PortalApiAnswer> portalFromApi(std::string_view json) {
    const auto read = readJSON(json, {.bytes = kLongestPortalAnswer, .depth = 8});
    const Value* value = std::get_if<Value>(&read);
    const DictionaryPointer* entries = value != nullptr ? value->as<DictionaryPointer>() : nullptr;
    if (entries == nullptr) return std::nullopt;
    const auto captive = (*entries)->value("captive");
    const bool* flag = captive ? captive->as<bool>() : nullptr;
    if (flag == nullptr) return std::nullopt;
    const auto page = (*entries)->value("user-portal-url");
    const std::string* text = page ? page->as<std::string>() : nullptr;
    PortalApiAnswer answer{*flag, text != nullptr ? plainText(*text, text->size()) : std::string()};
    // Without a page the user could do nothing about it; such an answer is not believed.
    if (answer.captive && answer.page.empty()) return std::nullopt;
    // Cut it would be another address.
    if (answer.page.size() > kLongestUrl) answer.page.clear();
    return answer;
}

std::string portalApiIn(const std::map<std::string, std::string>& lease) {
    // As NetworkManager passes them on: by names of its own that dhclient shares, by dhcpcd's, and by the numbers of a
    // dhclient that has no name for them. Of DHCPv6 it has no name itself.
    for (const char* name : {"default_url", "captive_portal_uri", "unknown_114", "v4_captive_portal",
                             "unknown_160", "dhcp6_v6_captive_portal", "dhcp6_unknown_103"}) {
        const auto found = lease.find(name);
        if (found != lease.end() && !found->second.empty()) return found->second;
    }
    return {};
}

bool meansNoPortal(std::string_view uri) {
    return uri == "urn:ietf:params:capport:unrestricted";
}

}  // namespace wp
