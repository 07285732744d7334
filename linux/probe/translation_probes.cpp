#include "linux/probe/translation_probes.h"

#include <linux/errqueue.h>
#include <netinet/in.h>
#include <netinet/ip_icmp.h>
#include <sys/random.h>

#include <algorithm>
#include <array>
#include <cstring>

#include "linux/probe/port_mapping.h"
#include "linux/probe/stun_message.h"

namespace wp {
namespace {

using namespace std::chrono_literals;

/// RFC 6886 begins with 250 ms and doubles; RFC 8489 with 500 ms. Both are cut to what a second allows.
const std::vector<std::chrono::milliseconds> kPauses = {250ms, 350ms};
constexpr int kFurthestHop = 4, kDatagramsPerHop = 2;
constexpr std::uint16_t kFirstPort = 33434;

template <std::size_t N>
std::array<std::uint8_t, N> randomBytes() {
    std::array<std::uint8_t, N> bytes{};
    // Up to 256 bytes come at once once the kernel's pool is ready; before that nothing runs anyway.
    (void)!::getrandom(bytes.data(), bytes.size(), 0);
    return bytes;
}

/// Maps a port of our own for the shortest time, reads the outer address from the answer, and takes it back.
Known<IPAddress> askByPcp(const Descriptor& socket, const SocketAddress& router, const IPAddress& own,
                          const Until& until) {
    const auto nonce = randomBytes<12>();
    SocketAddress local;
    local.size = sizeof local.storage;
    ::getsockname(socket.number(), reinterpret_cast<sockaddr*>(&local.storage), &local.size);
    std::optional<IPAddress> external;
    const auto request = pcpMapRequest(own, local.port(), nonce, 1);
    const Wait wait = exchangeDatagrams(
        socket, router, request, kPauses,
        [&](Bytes message, const SocketAddress& sender) {
            if (sender.isSame(router)) external = addressFromPcp(message, nonce);
            return external.has_value();
        },
        until);
    if (!external) return waitFailure(wait, "the router's port mapping (PCP)");
    const auto takeBack = pcpMapRequest(own, local.port(), nonce, 0);
    (void)::sendto(socket.number(), takeBack.data(), takeBack.size(), MSG_NOSIGNAL, router.raw(),
                   router.size);
    return *external;
}

struct Hop {
    std::size_t distance = 0;
    IPAddress address;
};

/// Who sent the ICMP error that is first in the queue, and for which distance.
std::optional<Hop> hopFrom(const msghdr& header, const SocketAddress& destination) {
    for (cmsghdr* part = CMSG_FIRSTHDR(&header); part != nullptr;
         part = CMSG_NXTHDR(const_cast<msghdr*>(&header), part)) {
        if (part->cmsg_level != SOL_IP || part->cmsg_type != IP_RECVERR) continue;
        const auto* error = reinterpret_cast<const sock_extended_err*>(CMSG_DATA(part));
        if (error->ee_origin != SO_EE_ORIGIN_ICMP) continue;
        SocketAddress offender;
        std::memcpy(&offender.storage, SO_EE_OFFENDER(error), sizeof(sockaddr_in));
        const auto address = offender.address();
        const int sent = destination.port() - kFirstPort;
        if (!address || sent < 0 || sent >= kFurthestHop * kDatagramsPerHop) continue;
        return Hop{static_cast<std::size_t>(sent / kDatagramsPerHop), *address};
    }
    return std::nullopt;
}

/// Takes one error from the queue; false when it is empty.
bool takeError(const Descriptor& socket, std::vector<std::optional<IPAddress>>& hops) {
    SocketAddress destination;
    std::array<char, 64> data;
    alignas(cmsghdr) std::array<char, 512> control;
    iovec vector{data.data(), data.size()};
    msghdr header{};
    header.msg_name = &destination.storage;
    header.msg_namelen = sizeof destination.storage;
    header.msg_iov = &vector;
    header.msg_iovlen = 1;
    header.msg_control = control.data();
    header.msg_controllen = control.size();
    if (::recvmsg(socket.number(), &header, MSG_ERRQUEUE | MSG_DONTWAIT) < 0) return false;
    const auto hop = hopFrom(header, destination);
    if (hop && !hops[hop->distance]) hops[hop->distance] = hop->address;
    return true;
}

void sendAll(const Descriptor& socket, const IPAddress& target) {
    for (int sent = 0; sent < kFurthestHop * kDatagramsPerHop; ++sent) {
        const int life = sent / kDatagramsPerHop + 1;
        const auto to = SocketAddress::of(target, static_cast<std::uint16_t>(kFirstPort + sent));
        ::setsockopt(socket.number(), SOL_IP, IP_TTL, &life, sizeof life);
        // An error that came back for an earlier one makes the next send fail once.
        for (int attempt = 0; attempt < 2; ++attempt)
            if (::sendto(socket.number(), "", 1, MSG_NOSIGNAL, to.raw(), to.size) >= 0) break;
    }
}

}  // namespace

Known<IPAddress> askMappedAddress(const IPAddress& server, std::uint16_t port,
                                  const std::string& interfaceName, const Until& until) {
    const auto socket = ipSocket(SOCK_DGRAM, server, interfaceName);
    if (!socket) return socket.error();
    const SocketAddress target = SocketAddress::of(server, port);
    const auto transaction = randomBytes<12>();
    std::optional<IPAddress> mapped;
    const Wait wait = exchangeDatagrams(
        *socket, target, stunBindingRequest(transaction), kPauses,
        [&](Bytes message, const SocketAddress& sender) {
            if (sender.isSame(target)) mapped = addressFromStun(message, transaction);
            return mapped.has_value();
        },
        until);
    if (!mapped) return waitFailure(wait, "the server outside (STUN)");
    return *mapped;
}

Known<IPAddress> askExternalAddress(const IPAddress& router, std::uint16_t port, const IPAddress& own,
                                    const std::string& interfaceName, const Until& until) {
    const auto socket = ipSocket(SOCK_DGRAM, router, interfaceName);
    if (!socket) return socket.error();
    const SocketAddress target = SocketAddress::of(router, port);
    std::optional<PortMappingAnswer> answer;
    const Wait wait = exchangeDatagrams(
        *socket, target, externalAddressRequest(), kPauses,
        [&](Bytes message, const SocketAddress& sender) {
            if (sender.isSame(target)) answer = readExternalAddress(message);
            return answer.has_value();
        },
        until);
    if (!answer) return waitFailure(wait, "the router's port mapping (NAT-PMP)");
    if (answer->speaksOnlyPcp) return askByPcp(*socket, target, own, until);
    if (!answer->external)
        return failure(Reason::unavailable, "the router does not tell its outer address (NAT-PMP)");
    return *answer->external;
}

Known<std::vector<std::optional<IPAddress>>> listHops(const IPAddress& target,
                                                      const std::string& interfaceName, const Until& until) {
    if (!target.isIPv4()) return failure(Reason::unsupported, "hops are listed for IPv4 only");
    const auto socket = ipSocket(SOCK_DGRAM, target, interfaceName);
    if (!socket) return socket.error();
    const int on = 1;
    ::setsockopt(socket->number(), SOL_IP, IP_RECVERR, &on, sizeof on);
    sendAll(*socket, target);
    std::vector<std::optional<IPAddress>> hops(kFurthestHop);
    while (!std::all_of(hops.begin(), hops.end(), [](const auto& hop) { return hop.has_value(); })) {
        pollfd descriptor{socket->number(), 0, 0};  // errors are always reported
        const Wait wait = waitAny({&descriptor, 1}, until);
        if (wait == Wait::stopped) return waitFailure(wait, "the way out");
        if (wait == Wait::timeout || Clock::now() >= until.deadline) break;
        while (takeError(*socket, hops) && Clock::now() < until.deadline) {
        }
        // An error without an entry in the queue would wake us again at once.
        int pending = 0;
        socklen_t size = sizeof pending;
        ::getsockopt(socket->number(), SOL_SOCKET, SO_ERROR, &pending, &size);
    }
    return hops;
}

}  // namespace wp
