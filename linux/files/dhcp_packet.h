#pragma once

#include <optional>

#include "linux/files/leases.h"
#include "service/bytes.h"

namespace wp {

/// What a DHCP server's answer grants, as some clients keep it byte for byte.
struct GrantedLease {
    std::uint32_t seconds = 0;  ///< for so long since the answer came; all bits set: without an end
    Lease lease;
};

/// Reads the packet with which a server of DHCPv4 grants a lease (RFC 2131 and 2132: an acknowledgement); an option may
/// come in parts (RFC 3396) and stand in the fields for a file and a server. Nothing for any other packet. *Any* thread.
std::optional<GrantedLease> readDhcpPacket(Bytes packet);

/// The same of DHCPv6 (RFC 8415: a reply with addresses), of which the longest lived counts.
std::optional<GrantedLease> readDhcp6Message(Bytes message);

}  // namespace wp
