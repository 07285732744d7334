#pragma once

#include <map>
#include <optional>
#include <string>
#include <string_view>

namespace wp {

/// The longest answer of a portal's API that is read; a true one has a few hundred bytes.
inline constexpr std::size_t kLongestPortalAnswer = 4096;

/// What the portal's API says (RFC 8908).
struct PortalApiAnswer {
    bool captive = false;
    std::string page;  ///< where the user is to go; empty if it has more than `kLongestUrl` bytes, or none is needed
};

/// Nothing for what is no such answer: not JSON, without "captive", or captive without a page to go to. *Any*
/// thread.
std::optional<PortalApiAnswer> portalFromApi(std::string_view json);

/// The address of the portal's API among the options of a lease in NetworkManager's form, by the names that DHCP clients
/// give them (RFC 8910: option 114, withdrawn 160; of DHCPv6 103); empty where the network names none.
std::string portalApiIn(const std::map<std::string, std::string>& lease);

/// Whether the address is the one that means "no portal here".
bool meansNoPortal(std::string_view uri);

}  // namespace wp
