#pragma once

#include <array>
#include <optional>
#include <vector>

#include "service/ip_address.h"

namespace wp {

/// What ties an answer to its request; random.
using StunTransaction = std::array<std::uint8_t, 12>;

/// A binding request (RFC 8489): 20 bytes without attributes.
std::vector<std::uint8_t> stunBindingRequest(const StunTransaction& transaction);

/// The address that the server saw, from a success response to this very request; nothing for any other
/// message. Reads the XOR-MAPPED-ADDRESS, else the older MAPPED-ADDRESS, which some routers rewrite. *Any*
/// thread.
std::optional<IPAddress> addressFromStun(Bytes message, const StunTransaction& transaction);

}  // namespace wp
