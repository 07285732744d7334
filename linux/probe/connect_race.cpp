#include "linux/probe/connect_race.h"

#include <net/if.h>

#include <algorithm>
#include <cerrno>
#include <cstring>

namespace wp {
namespace {

constexpr std::chrono::milliseconds kApart{250};  // RFC 8305, 5

/// The families by turns, the first address's family first, each in its own order.
std::vector<IPAddress> byTurns(const std::vector<IPAddress>& addresses) {
    std::vector<IPAddress> families[2], mixed;
    for (const IPAddress& each : addresses)
        families[each.isIPv4() == addresses.front().isIPv4() ? 0 : 1].push_back(each);
    for (std::size_t i = 0; mixed.size() < addresses.size(); ++i)
        for (const auto& family : families)
            if (i < family.size()) mixed.push_back(family[i]);
    return mixed;
}

}  // namespace

ConnectRace::ConnectRace(const std::vector<IPAddress>& addresses, std::uint16_t port,
                         std::string interfaceName)
    : addresses_(byTurns(addresses)),
      port_(port),
      interfaceName_(std::move(interfaceName)),
      interfaceIndex_(interfaceName_.empty() ? 0 : ::if_nametoindex(interfaceName_.c_str())) {}

void ConnectRace::advance(Clock::time_point now) {
    while (!winner_) {
        if (std::erase_if(running_, [this](Attempt& each) { return settle(each); }) > 0) nextStart_ = now;
        const bool isDue = running_.empty() || now >= nextStart_;
        if (winner_ || next_ == addresses_.size() || !isDue) break;
        start(now);
    }
    if (winner_) running_.clear();
}

void ConnectRace::addWaits(std::vector<pollfd>& waits, Clock::time_point& wake) const {
    for (const Attempt& each : running_) waits.push_back({each.socket.number(), POLLOUT, 0});
    if (next_ < addresses_.size()) wake = std::min(wake, nextStart_);
}

void ConnectRace::start(Clock::time_point now) {
    const IPAddress& address = addresses_[next_++];
    Known<Descriptor> socket = ipSocket(SOCK_STREAM, address, interfaceName_);
    if (!socket) {
        why_ = socket.error().message;
        return;
    }
    running_.push_back({address, std::move(*socket)});
    nextStart_ = now + kApart;
}

bool ConnectRace::settle(Attempt& attempt) {
    if (winner_) return true;
    const SocketAddress target = SocketAddress::of(attempt.address, port_, interfaceIndex_);
    // Asked again, the kernel says what has become of a connection that is under way.
    const bool isThere =
        ::connect(attempt.socket.number(), target.raw(), target.size) == 0 || errno == EISCONN;
    if (!isThere && (errno == EINPROGRESS || errno == EALREADY || errno == EINTR)) return false;
    if (isThere) {
        winner_ = std::move(attempt.socket);
        winnersAddress_ = attempt.address;
    } else {
        why_ = "no connection to " + attempt.address.text() + ": " + std::strerror(errno);
    }
    return true;
}

}  // namespace wp
