#pragma once

#include <optional>
#include <vector>

#include "service/facts.h"

namespace wp {

// The bytes of ICMP's echo messages. Pure functions; *any* thread.

struct EchoTag {
    std::uint16_t identifier = 0;
    std::uint16_t sequence = 0;
    friend bool operator==(const EchoTag&, const EchoTag&) = default;
};

/// A request with the checksum that IPv4 wants; the kernel itself fills in IPv6's.
std::vector<std::uint8_t> echoRequest(Address::Family family, EchoTag tag);

/// How the kernel hands over what came.
enum class EchoFraming { bare, behindIPv4Header };

/// The tag of an echo reply; nothing when the bytes are something else.
std::optional<EchoTag> readEchoReply(Address::Family family, EchoFraming framing, Bytes packet);

}  // namespace wp
