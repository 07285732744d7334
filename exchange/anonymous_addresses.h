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

    /// The text with each address in it replaced, and each in the name of an interface that is made from one
    /// ("wlx" and its digits).
    std::string replacedWithin(std::string_view text);

  private:
    std::string interfaceName(std::string_view name);
    std::string replacement(const std::string& word);
    std::string ipv4(const std::string& word);
    std::string ipv6(const std::string& word);

    std::map<std::string, std::uint32_t> hardware_;
    std::map<std::string, std::uint32_t> ipv4_;
    std::map<std::string, std::uint32_t> ipv6_;
};

}  // namespace wp
