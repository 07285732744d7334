#pragma once

#include <string>
#include <vector>

#include "linux/netlink_socket.h"
#include "linux/radio_socket.h"

namespace wp {

/// All messages of one kind about addresses, routes or neighbours, of both families. Blocks. *Any* thread.
/// @tparam Header what stands before the attributes of that kind
template <class Header>
Known<std::vector<std::uint8_t>> routeDump(std::uint16_t type, const std::string& what, const Until& until) {
    Known<NetlinkSocket> socket = NetlinkSocket::open(NETLINK_ROUTE);
    if (!socket) return socket.error();
    NetlinkRequest request(type, NLM_F_DUMP);
    request.header<Header>() = {};
    NetlinkAnswer answer = socket->ask(request, until);
    if (answer.error != 0) return failureOf(answer.error, what);
    return std::move(answer.messages);
}

}  // namespace wp
