#include "linux/echo_socket.h"

#include <arpa/inet.h>
#include <netinet/icmp6.h>
#include <netinet/in.h>
#include <sys/socket.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <ctime>
#include <random>

#include "service/thresholds.h"

namespace wp {
namespace {

using std::chrono::milliseconds;

constexpr milliseconds kApart{200};
constexpr milliseconds kWait{1000};
constexpr milliseconds kSilence{300};
// Five visits and what goes between them are over by then.
constexpr milliseconds kPatience{1500};

struct SocketAddress {
    sockaddr_storage storage{};
    socklen_t size = 0;
    sockaddr* get() { return reinterpret_cast<sockaddr*>(&storage); }
};

SocketAddress addressOf(const Gateway& target, std::uint32_t interfaceIndex) {
    SocketAddress address;
    if (target.family == Address::Family::ipv4) {
        auto* const ipv4 = reinterpret_cast<sockaddr_in*>(&address.storage);
        ipv4->sin_family = AF_INET;
        std::memcpy(&ipv4->sin_addr, target.bytes.data(), sizeof ipv4->sin_addr);
        address.size = sizeof *ipv4;
    } else {
        auto* const ipv6 = reinterpret_cast<sockaddr_in6*>(&address.storage);
        ipv6->sin6_family = AF_INET6;
        std::memcpy(&ipv6->sin6_addr, target.bytes.data(), sizeof ipv6->sin6_addr);
        if (IN6_IS_ADDR_LINKLOCAL(&ipv6->sin6_addr)) ipv6->sin6_scope_id = interfaceIndex;
        address.size = sizeof *ipv6;
    }
    return address;
}

bool isFrom(const sockaddr_storage& sender, const Gateway& target) {
    if (target.family == Address::Family::ipv4) {
        const auto* const ipv4 = reinterpret_cast<const sockaddr_in*>(&sender);
        return ipv4->sin_family == AF_INET && std::memcmp(&ipv4->sin_addr, target.bytes.data(), 4) == 0;
    }
    const auto* const ipv6 = reinterpret_cast<const sockaddr_in6*>(&sender);
    return ipv6->sin6_family == AF_INET6 && std::memcmp(&ipv6->sin6_addr, target.bytes.data(), 16) == 0;
}

/// Leaves by this interface; unlike binding to a device it may be changed without any privilege.
bool leaveBy(int descriptor, Address::Family family, std::uint32_t interfaceIndex) {
    const std::uint32_t index = htonl(interfaceIndex);
    return family == Address::Family::ipv4
               ? setsockopt(descriptor, IPPROTO_IP, IP_UNICAST_IF, &index, sizeof index) == 0
               : setsockopt(descriptor, IPPROTO_IPV6, IPV6_UNICAST_IF, &index, sizeof index) == 0;
}

std::uint16_t randomIdentifier() {
    return static_cast<std::uint16_t>(std::random_device()());
}

/// One row of requests and the answers to it.
class EchoRow {
  public:
    EchoRow(int descriptor, bool raw, const Gateway& target, SocketAddress address, HomeChannel::Stay& stay)
        : descriptor_(descriptor), raw_(raw), target_(target), address_(address), stay_(stay) {}

    /// Nothing, or why the row could not be completed.
    std::optional<Error> run(const Until& until) {
        drain();
        if (!sendAll(until) || !receiveUntil(sent_.back() + kSilence, until))
            return waitFailure(Wait::stopped, "echo");
        if (std::ranges::none_of(answered_, [](auto& each) { return each.has_value(); })) stay_.end();
        if (!receiveUntil(sent_.back() + kWait, until)) return waitFailure(Wait::stopped, "echo");
        return std::nullopt;
    }

    std::vector<std::optional<double>> roundTrips() const { return {answered_.begin(), answered_.end()}; }

  private:
    /// Takes what is answered between the requests too. False when stopped.
    bool sendAll(const Until& until) {
        // Somebody else's scan may last longer than it is worth waiting for.
        const Until patience = until.within(kPatience);
        for (std::size_t i = 0; i < kEchoRequests; ++i) {
            if (stay_.begin(patience) == Wait::stopped) return false;
            sent_[i] = Clock::now();
            const std::vector<std::uint8_t> request =
                echoRequest(target_.family, {identifier_, static_cast<std::uint16_t>(firstSequence_ + i)});
            // A request that cannot be sent (no route, no neighbour) is one that nobody answers.
            [[maybe_unused]] const ssize_t size =
                sendto(descriptor_, request.data(), request.size(), 0, address_.get(), address_.size);
            asked_ = i + 1;
            if (asked_ < kEchoRequests && !receiveUntil(sent_[i] + kApart, until)) return false;
        }
        return true;
    }

    bool isWaitingForAnswers() const {
        return std::any_of(answered_.begin(), answered_.begin() + static_cast<std::ptrdiff_t>(asked_),
                           [](auto& each) { return !each; });
    }

    /// Takes answers until the time is over, or, after the last request, until all are there. False when stopped.
    bool receiveUntil(Clock::time_point time, const Until& until) {
        while (asked_ < kEchoRequests || isWaitingForAnswers()) {
            if (!isWaitingForAnswers()) stay_.pause();
            const Wait wait = waitReadable(descriptor_, {until.stop, std::min(time, until.deadline)});
            if (wait == Wait::stopped) return false;
            if (wait == Wait::timeout) return true;
            receive();
        }
        return true;
    }

    void receive() {
        std::array<std::uint8_t, 2048> packet;
        sockaddr_storage sender{};
        socklen_t size = sizeof sender;
        const ssize_t received = recvfrom(descriptor_, packet.data(), packet.size(), MSG_DONTWAIT,
                                          reinterpret_cast<sockaddr*>(&sender), &size);
        const Clock::time_point now = Clock::now();
        if (received < 0 || !isFrom(sender, target_)) return;
        const bool framed = raw_ && target_.family == Address::Family::ipv4;
        const auto tag =
            readEchoReply(target_.family, framed ? EchoFraming::behindIPv4Header : EchoFraming::bare,
                          {packet.data(), static_cast<std::size_t>(received)});
        // The kernel puts a number of its own into what a datagram socket sends, and delivers its answers only.
        if (!tag || (raw_ && tag->identifier != identifier_)) return;
        const std::size_t index = static_cast<std::uint16_t>(tag->sequence - firstSequence_);
        if (index >= asked_ || answered_[index] || now - sent_[index] > kWait) return;
        answered_[index] = std::chrono::duration<double, std::milli>(now - sent_[index]).count();
    }

    /// Throws away what came since the last row.
    void drain() {
        std::array<std::uint8_t, 2048> packet;
        while (recv(descriptor_, packet.data(), packet.size(), MSG_DONTWAIT) >= 0) {
        }
    }

    int descriptor_;
    bool raw_;
    const Gateway& target_;
    SocketAddress address_;
    HomeChannel::Stay& stay_;
    std::uint16_t identifier_ = randomIdentifier();
    std::uint16_t firstSequence_ = randomIdentifier();
    std::array<Clock::time_point, kEchoRequests> sent_{};
    std::array<std::optional<double>, kEchoRequests> answered_{};
    std::size_t asked_ = 0;
};

}  // namespace

double secondsSinceReference() {
    constexpr double kReference = 978307200;  // in seconds since 1970
    timespec now{};
    clock_gettime(CLOCK_REALTIME, &now);
    return static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) / 1e9 - kReference;
}

EchoSocket::EchoSocket() : ipv4_(open(Address::Family::ipv4)), ipv6_(open(Address::Family::ipv6)) {}

EchoSocket::End EchoSocket::open(Address::Family family) {
    const bool ipv4 = family == Address::Family::ipv4;
    const int domain = ipv4 ? AF_INET : AF_INET6;
    const int protocol = ipv4 ? int{IPPROTO_ICMP} : int{IPPROTO_ICMPV6};
    End end;
    for (const int type : {SOCK_DGRAM, SOCK_RAW}) {
        end.descriptor = Descriptor(socket(domain, type | SOCK_CLOEXEC | SOCK_NONBLOCK, protocol));
        end.raw = type == SOCK_RAW;
        end.error = end.descriptor ? 0 : errno;
        if (end.descriptor) break;
    }
    if (end.raw && end.descriptor && !ipv4) {
        icmp6_filter filter;
        ICMP6_FILTER_SETBLOCKALL(&filter);
        ICMP6_FILTER_SETPASS(ICMP6_ECHO_REPLY, &filter);
        setsockopt(end.descriptor.number(), IPPROTO_ICMPV6, ICMP6_FILTER, &filter, sizeof filter);
    }
    return end;
}

Known<Echo> EchoSocket::ask(const Gateway& target, const std::string& interfaceName,
                            std::uint32_t interfaceIndex, HomeChannel::Stay& stay, const Until& until) {
    const std::lock_guard lock(asking_);
    const End& end = this->end(target.family);
    if (!end.descriptor) {
        if (end.error == EPERM || end.error == EACCES)
            return failure(Reason::notPermitted,
                           "no permission to ping (net.ipv4.ping_group_range or CAP_NET_RAW)");
        return failure(Reason::unavailable,
                       std::string("no echo requests (ping): ") + std::strerror(end.error));
    }
    if (!leaveBy(end.descriptor.number(), target.family, interfaceIndex)) {
        return failure(Reason::noInterface, interfaceName + " is gone");
    }
    const double startedAt = secondsSinceReference();
    EchoRow row(end.descriptor.number(), end.raw, target, addressOf(target, interfaceIndex), stay);
    if (std::optional<Error> error = row.run(until)) return *error;
    return Echo{interfaceName, textOf(target.family, target.bytes), row.roundTrips(), startedAt};
}

}  // namespace wp
