#pragma once

#include <array>
#include <optional>
#include <vector>

#include "service/ip_address.h"

namespace wp {

inline constexpr std::uint16_t kPortMappingPort = 5351;

/// NAT-PMP's question for the router's outer address (RFC 6886, opcode 0): it changes nothing there.
std::vector<std::uint8_t> externalAddressRequest();

/// What the router said to it.
struct PortMappingAnswer {
    std::optional<IPAddress> external;
    bool speaksOnlyPcp = false;  ///< understood, but wants the younger protocol
};

/// Reads a router's answer; nothing for a message that is none. *Any* thread.
std::optional<PortMappingAnswer> readExternalAddress(Bytes message);

using PcpNonce = std::array<std::uint8_t, 12>;

/// PCP (RFC 6887) tells the outer address only with a mapping: this one maps a UDP port of our own, where
/// nothing listens. \param seconds its life; 0 takes it back
std::vector<std::uint8_t> pcpMapRequest(const IPAddress& own, std::uint16_t port, const PcpNonce& nonce,
                                        std::uint32_t seconds);

/// The outer address in the answer to that request; nothing for a refusal or any other message. *Any* thread.
std::optional<IPAddress> addressFromPcp(Bytes message, const PcpNonce& nonce);

}  // namespace wp
