#include "linux/files/address_list.h"

namespace wp {

std::vector<IPAddress> addressesIn(std::string_view list) {
    constexpr std::string_view kBetween = " \t\r\n,";
    std::vector<IPAddress> addresses;
    while (true) {
        const std::size_t start = list.find_first_not_of(kBetween);
        if (start == list.npos) return addresses;
        list.remove_prefix(start);
        const std::string_view word = list.substr(0, list.find_first_of(kBetween));
        if (const auto address = IPAddress::fromText(word.substr(0, word.find('/'))))
            addresses.push_back(*address);
        list.remove_prefix(word.size());
    }
}

std::optional<IPAddress> serverFrom(std::string_view text) {
    if (const std::size_t scheme = text.find("://"); scheme != text.npos) text.remove_prefix(scheme + 3);
    text = text.substr(0, text.find('#'));
    if (text.starts_with("[")) return IPAddress::fromText(text.substr(1, text.find(']') - 1));
    // One colon alone parts the port from an address of IPv4.
    const std::size_t colon = text.find(':');
    const bool isPort = colon != text.npos && text.find(':', colon + 1) == text.npos;
    return IPAddress::fromText(isPort ? text.substr(0, colon) : text);
}

}  // namespace wp
