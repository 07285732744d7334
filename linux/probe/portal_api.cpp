#include "linux/probe/portal_api.h"

#include "exchange/json_reader.h"
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
    // Without a page the user could do nothing about it; such an answer is not believed.
    if (*flag && (text == nullptr || text->empty())) return std::nullopt;
    return PortalApiAnswer{*flag, text != nullptr ? plainText(*text, 2048) : std::string()};
}

std::string portalApiIn(const std::map<std::string, std::string>& lease) {
    // By what NetworkManager calls them (its internal client, then dhclient's numbers), then networkd.
    for (const char* name : {"captive_portal", "unknown_114", "114", "default_url", "dhcp6_captive_portal",
                             "unknown_103", "private_160", "unknown_160"}) {
        const auto found = lease.find(name);
        if (found != lease.end() && !found->second.empty()) return found->second;
    }
    return {};
}

bool meansNoPortal(std::string_view uri) {
    return uri == "urn:ietf:params:capport:unrestricted";
}

}  // namespace wp
