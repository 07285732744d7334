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

}  // namespace wp
