#pragma once

#include <sys/socket.h>

#include <functional>
#include <string>
#include <vector>

#include "exchange/descriptor.h"
#include "linux/wait_any.h"
#include "service/ip_address.h"

namespace wp {

/// An address with a port, in the form that the kernel takes.
struct SocketAddress {
    sockaddr_storage storage{};
    socklen_t size = 0;

    /// \param interfaceIndex for link-local addresses of IPv6; 0 where it does not matter
    static SocketAddress of(const IPAddress& address, std::uint16_t port, unsigned interfaceIndex = 0);
    /// The address without its port; nothing where it is of no IP family.
    std::optional<IPAddress> address() const;
    std::uint16_t port() const;
    /// Whether both are the same address and port.
    bool isSame(const SocketAddress& other) const;
    const sockaddr* raw() const { return reinterpret_cast<const sockaddr*>(&storage); }
};

/// A socket of the family of `address` that never blocks, bound to the interface where one is named; one for datagrams
/// also to the source that the kernel takes there. Being refused the interface is `notPermitted`.
/// \param type SOCK_DGRAM or SOCK_STREAM
Known<Descriptor> ipSocket(int type, const IPAddress& address, const std::string& interfaceName);

/// The interface's address from which the kernel sends to that one over it. A socket that is not connected is led on before
/// it has one, past the rules of routes that go by it. Nothing where no address is reached so. *Any* thread.
std::optional<IPAddress> sourceToward(const IPAddress& destination, const std::string& interfaceName);

/// Why no socket can be bound to the interface; nothing where one can, or where none is named. Kernels before 5.7 want
/// CAP_NET_RAW for it. Whoever leaves this out tells of a network that was never asked. *Any* thread.
std::optional<Error> refusalOf(const std::string& interfaceName);

/// Looks at one answer and where it came from; true ends the exchange.
using AcceptDatagram = std::function<bool(Bytes message, const SocketAddress& sender)>;

/// Sends the request and waits for an answer that is accepted; sends it again after each of the pauses.
/// Datagrams longer than 4 KiB are cut there. No number of answers that are not accepted keeps it beyond its time.
Wait exchangeDatagrams(const Descriptor& socket, const SocketAddress& target, Bytes request,
                       const std::vector<std::chrono::milliseconds>& pauses, const AcceptDatagram& accept,
                       const Until& until);

}  // namespace wp
