#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <string_view>

namespace wp {

/// Replacements for hardware and IP addresses, given out in the order in which addresses turn up. Not for
/// several threads at once.
class AnonymousAddresses {
  public:
    /// The replacement of a BSSID field, whatever its form.
    std::string hardwareAddress(const std::string& address);

    /// The text with each address in it replaced: hardware addresses in each of their usual forms, also where an
    /// interface is named after its own ("wlx" and twelve digits), and IP addresses.
    std::string replacedWithin(std::string_view text);

  private:
    /// A piece of a text, and what takes its place.
    struct Found {
        std::size_t length = 0;
        std::string replacement;
    };
    Found addressAt(std::string_view text, std::size_t begin);
    Found hardwareAt(std::string_view text, std::size_t begin);
    Found internetAt(std::string_view text, std::size_t begin);
    std::string ipv4(const std::string& word);
    std::string ipv6(const std::string& word);

    std::map<std::string, std::uint32_t> hardware_;
    std::map<std::string, std::uint32_t> ipv4_;
    std::map<std::string, std::uint32_t> ipv6_;
};

}  // namespace wp
