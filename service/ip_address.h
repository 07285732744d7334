#pragma once

#include <array>
#include <compare>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "service/bytes.h"

namespace wp {

/// An address of IPv4 or IPv6, and what its range says of it. *Any* thread.
class IPAddress {
  public:
    /// The unspecified address of IPv4, 0.0.0.0.
    IPAddress() = default;

    /// Reads the dotted form, or the colon form of IPv6; a zone ("%wlan0") may follow and is dropped. Nothing
    /// where the text is no address.
    static std::optional<IPAddress> fromText(std::string_view text);
    /// 4 or 16 bytes, the highest first; nothing for any other number. An IPv4 address mapped into IPv6
    /// becomes the IPv4 address that it stands for.
    static std::optional<IPAddress> fromBytes(Bytes bytes);

    bool isIPv4() const { return size_ == 4; }
    Bytes bytes() const { return {bytes_.data(), size_}; }
    /// "192.0.2.1", "2001:db8::1".
    std::string text() const;

    bool unspecified() const;
    bool loopback() const;
    bool linkLocal() const;
    /// For use inside a site: RFC 1918 of IPv4, the unique local addresses (RFC 4193) of IPv6.
    bool privateUse() const;
    /// 100.64.0.0/10, between a provider's translator and its customers (RFC 6598).
    bool sharedUse() const;
    bool multicast() const;
    /// Reachable from everywhere: none of the above.
    bool global() const;

    /// Whether the first `length` bits are those of `other`; never between the two families.
    bool sharesPrefix(const IPAddress& other, unsigned length) const;

    friend auto operator<=>(const IPAddress&, const IPAddress&) = default;

  private:
    std::array<std::uint8_t, 16> bytes_{};
    std::uint8_t size_ = 4;
};

/// Whether the address is among these. *Any* thread.
bool contains(const std::vector<IPAddress>& list, const IPAddress& address);
/// Adds those that are not there yet. *Any* thread.
void add(std::vector<IPAddress>& list, const std::vector<IPAddress>& more);
/// The list but for the others, in its order. *Any* thread.
std::vector<IPAddress> without(std::vector<IPAddress> list, const std::vector<IPAddress>& others);

}  // namespace wp
