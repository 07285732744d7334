#include "linux/probe/ip_socket.h"

#include <net/if.h>
#include <netinet/in.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>

namespace wp {
namespace {

constexpr std::size_t kLongestDatagram = 4096;

/// Takes in the next datagram; whether it is accepted.
bool receiveNext(const Descriptor& socket, const AcceptDatagram& accept) {
    std::array<std::uint8_t, kLongestDatagram> buffer;
    SocketAddress from;
    from.size = sizeof from.storage;
    const ssize_t size = ::recvfrom(socket.number(), buffer.data(), buffer.size(), MSG_DONTWAIT,
                                    reinterpret_cast<sockaddr*>(&from.storage), &from.size);
    return size >= 0 && from.address() && accept({buffer.data(), static_cast<std::size_t>(size)}, from);
}

/// Bound to the interface alone.
Known<Descriptor> boundSocket(int type, const IPAddress& address, const std::string& interfaceName) {
    const int family = address.isIPv4() ? AF_INET : AF_INET6;
    Descriptor socket(::socket(family, type | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
    if (!socket)
        return failure(Reason::unsupported, std::string("no socket of this family: ") + std::strerror(errno));
    const auto size = static_cast<socklen_t>(interfaceName.size());
    if (size != 0 &&
        ::setsockopt(socket.number(), SOL_SOCKET, SO_BINDTODEVICE, interfaceName.c_str(), size) != 0)
        return failure(errno == EPERM ? Reason::notPermitted : Reason::noInterface,
                       "cannot send over " + interfaceName + ": " + std::strerror(errno));
    return socket;
}

}  // namespace

SocketAddress SocketAddress::of(const IPAddress& address, std::uint16_t port, unsigned interfaceIndex) {
    SocketAddress result;
    if (address.isIPv4()) {
        auto& place = *reinterpret_cast<sockaddr_in*>(&result.storage);
        place.sin_family = AF_INET;
        place.sin_port = htons(port);
        std::copy(address.bytes().begin(), address.bytes().end(),
                  reinterpret_cast<std::uint8_t*>(&place.sin_addr));
        result.size = sizeof place;
        return result;
    }
    auto& place = *reinterpret_cast<sockaddr_in6*>(&result.storage);
    place.sin6_family = AF_INET6;
    place.sin6_port = htons(port);
    place.sin6_scope_id = address.linkLocal() ? interfaceIndex : 0;
    std::copy(address.bytes().begin(), address.bytes().end(), place.sin6_addr.s6_addr);
    result.size = sizeof place;
    return result;
}

std::optional<IPAddress> SocketAddress::address() const {
    if (storage.ss_family == AF_INET) {
        const auto& place = *reinterpret_cast<const sockaddr_in*>(&storage);
        return IPAddress::fromBytes({reinterpret_cast<const std::uint8_t*>(&place.sin_addr), 4});
    }
    if (storage.ss_family != AF_INET6) return std::nullopt;
    return IPAddress::fromBytes({reinterpret_cast<const sockaddr_in6*>(&storage)->sin6_addr.s6_addr, 16});
}

std::uint16_t SocketAddress::port() const {
    if (storage.ss_family == AF_INET) return ntohs(reinterpret_cast<const sockaddr_in*>(&storage)->sin_port);
    return ntohs(reinterpret_cast<const sockaddr_in6*>(&storage)->sin6_port);
}

bool SocketAddress::isSame(const SocketAddress& other) const {
    return address() == other.address() && port() == other.port();
}

Known<Descriptor> ipSocket(int type, const IPAddress& address, const std::string& interfaceName) {
    Known<Descriptor> socket = boundSocket(type, address, interfaceName);
    if (!socket || type != SOCK_DGRAM || interfaceName.empty()) return socket;
    // Without it the datagrams go where those go that come from nowhere in particular.
    if (const auto source = sourceToward(address, interfaceName)) {
        const SocketAddress own = SocketAddress::of(*source, 0, ::if_nametoindex(interfaceName.c_str()));
        (void)::bind(socket->number(), own.raw(), own.size);
    }
    return socket;
}

std::optional<IPAddress> sourceToward(const IPAddress& destination, const std::string& interfaceName) {
    constexpr std::uint16_t kAnyPort = 9;
    const auto socket = boundSocket(SOCK_DGRAM, destination, interfaceName);
    if (!socket) return std::nullopt;
    const SocketAddress target =
        SocketAddress::of(destination, kAnyPort, ::if_nametoindex(interfaceName.c_str()));
    SocketAddress own;
    own.size = sizeof own.storage;
    // That only chooses the way; nothing is sent.
    if (::connect(socket->number(), target.raw(), target.size) != 0 ||
        ::getsockname(socket->number(), reinterpret_cast<sockaddr*>(&own.storage), &own.size) != 0)
        return std::nullopt;
    return own.address();
}

std::optional<Error> refusalOf(const std::string& interfaceName) {
    if (interfaceName.empty()) return std::nullopt;
    const auto socket = boundSocket(SOCK_DGRAM, IPAddress(), interfaceName);
    return socket ? std::nullopt : std::optional(socket.error());
}

Wait exchangeDatagrams(const Descriptor& socket, const SocketAddress& target, Bytes request,
                       const std::vector<std::chrono::milliseconds>& pauses, const AcceptDatagram& accept,
                       const Until& until) {
    for (std::size_t turn = 0; turn <= pauses.size(); ++turn) {
        // A send that fails (no route yet, an earlier refusal) counts as a datagram that was lost.
        (void)::sendto(socket.number(), request.data(), request.size(), MSG_NOSIGNAL, target.raw(),
                       target.size);
        const Until own = turn < pauses.size() ? until.within(pauses[turn]) : until;
        do {
            pollfd descriptor{socket.number(), POLLIN, 0};
            const Wait wait = waitAny({&descriptor, 1}, own);
            if (wait == Wait::stopped) return wait;
            if (wait == Wait::ready && receiveNext(socket, accept)) return wait;
        } while (Clock::now() < own.deadline);
    }
    return Wait::timeout;
}

}  // namespace wp
