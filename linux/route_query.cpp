#include "linux/route_query.h"

#include <linux/rtnetlink.h>
#include <sys/socket.h>

#include <cerrno>

#include "linux/netlink_socket.h"
#include "linux/probe/ip_socket.h"
#include "linux/radio_socket.h"

namespace wp {
namespace {

// Far from every network: only a default route leads there. Nothing is sent to them.
constexpr const char* kOutside[] = {"9.9.9.9", "2620:fe::9"};

/// Without the flag the kernel would also answer with its guess that what no route leads to is on the link.
NetlinkRequest& fill(NetlinkRequest& request, const RouteQuestion& question) {
    const IPAddress& destination = question.destination;
    const auto length = static_cast<unsigned char>(destination.bytes().size() * 8);
    rtmsg& header = request.header<rtmsg>();
    header.rtm_family = destination.isIPv4() ? AF_INET : AF_INET6;
    header.rtm_dst_len = length;
    header.rtm_flags = RTM_F_FIB_MATCH;
    request.put(RTA_DST, destination.bytes());
    if (question.interfaceIndex != 0) request.put(RTA_OIF, question.interfaceIndex);
    if (!question.source) return request;
    header.rtm_src_len = length;
    request.put(RTA_SRC, question.source->bytes());
    return request;
}

bool isOver(int error) {
    return error == ETIME || error == ECANCELED;
}

}  // namespace

Known<std::optional<Route>> routeFor(const RouteQuestion& question, const Until& until) {
    Known<NetlinkSocket> socket = NetlinkSocket::open(NETLINK_ROUTE);
    if (!socket) return socket.error();
    NetlinkRequest request(RTM_GETROUTE, 0);
    const NetlinkAnswer answer = socket->ask(fill(request, question), until);
    if (isOver(answer.error)) return failureOf(answer.error, "routes");
    if (answer.error != 0) return std::optional<Route>();
    return readRoute(answer.messages);
}

Known<std::optional<Route>> routeOver(const Link& link, const IPAddress& destination, const Until& until) {
    auto route = routeFor({destination, link.interfaceIndex}, until);
    if (!route || *route) return route;
    const auto source = sourceToward(destination, link.interfaceName);
    return source ? routeFor({destination, link.interfaceIndex, source}, until) : route;
}

Known<std::vector<WayOut>> gatherWaysOut(const Link& link, const Until& until) {
    std::vector<WayOut> ways;
    for (const char* const outside : kOutside) {
        const IPAddress destination = *IPAddress::fromText(outside);
        const auto route = routeOver(link, destination, until);
        if (!route) return route.error();
        const NextHop* const hop = *route ? (*route)->over(link.interfaceIndex) : nullptr;
        if (hop != nullptr) ways.push_back({destination.isIPv4(), hop->router});
    }
    return ways;
}

}  // namespace wp
