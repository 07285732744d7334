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

#include "linux/probe/ip_socket.h"
#include "service/thresholds.h"

namespace wp {
namespace {

using std::chrono::milliseconds;

constexpr milliseconds kApart{200};
constexpr milliseconds kWait{1000};
constexpr milliseconds kSilence{300};
// Five visits and what goes between them are over by then.
constexpr milliseconds kPatience{1500};

Address::Family familyOf(const IPAddress& address) {
    return address.isIPv4() ? Address::Family::ipv4 : Address::Family::ipv6;
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

/// Whom a row of requests is for, and from which address it comes.
struct EchoWay {
    IPAddress target;
    SocketAddress address;
    std::optional<IPAddress> source;  ///< of IPv4 alone: the kernel itself takes that of IPv6 into account
};

EchoWay wayTo(const IPAddress& target, const std::string& interfaceName, std::uint32_t interfaceIndex) {
    EchoWay way{target, SocketAddress::of(target, 0, interfaceIndex), std::nullopt};
    if (target.isIPv4()) way.source = sourceToward(target, interfaceName);
    return way;
}

/// A request that cannot be sent (no route, no neighbour) is one that nobody answers.
void send(int descriptor, const EchoWay& way, const std::vector<std::uint8_t>& request) {
    iovec content{const_cast<std::uint8_t*>(request.data()), request.size()};
    alignas(cmsghdr) std::array<char, CMSG_SPACE(sizeof(in_pktinfo))> control{};
    msghdr message{};
    message.msg_name = const_cast<sockaddr*>(way.address.raw());
    message.msg_namelen = way.address.size;
    message.msg_iov = &content;
    message.msg_iovlen = 1;
    if (way.source) {
        in_pktinfo origin{};
        std::ranges::copy(way.source->bytes(), reinterpret_cast<std::uint8_t*>(&origin.ipi_spec_dst));
        message.msg_control = control.data();
        message.msg_controllen = control.size();
        cmsghdr& part = *CMSG_FIRSTHDR(&message);
        part.cmsg_level = IPPROTO_IP;
        part.cmsg_type = IP_PKTINFO;
        part.cmsg_len = CMSG_LEN(sizeof origin);
        std::memcpy(CMSG_DATA(&part), &origin, sizeof origin);
    }
    (void)!::sendmsg(descriptor, &message, 0);
}

/// One row of requests and the answers to it.
class EchoRow {
  public:
    EchoRow(int descriptor, bool raw, const EchoWay& way, HomeChannel::Stay& stay)
        : descriptor_(descriptor), raw_(raw), way_(way), stay_(stay) {}

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
            send(descriptor_, way_,
                 echoRequest(family_, {identifier_, static_cast<std::uint16_t>(firstSequence_ + i)}));
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
        SocketAddress sender;
        sender.size = sizeof sender.storage;
        const ssize_t received = recvfrom(descriptor_, packet.data(), packet.size(), MSG_DONTWAIT,
                                          reinterpret_cast<sockaddr*>(&sender.storage), &sender.size);
        const Clock::time_point now = Clock::now();
        if (received < 0 || sender.address() != way_.target) return;
        const bool framed = raw_ && family_ == Address::Family::ipv4;
        const auto tag = readEchoReply(family_, framed ? EchoFraming::behindIPv4Header : EchoFraming::bare,
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
    const EchoWay& way_;
    const Address::Family family_ = familyOf(way_.target);
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

Known<Echo> EchoSocket::ask(const IPAddress& target, const std::string& interfaceName,
                            std::uint32_t interfaceIndex, HomeChannel::Stay& stay, const Until& until) {
    const std::lock_guard lock(asking_);
    const Address::Family family = familyOf(target);
    const End& end = this->end(family);
    if (!end.descriptor) {
        if (end.error == EPERM || end.error == EACCES)
            return failure(Reason::notPermitted,
                           "no permission to ping (net.ipv4.ping_group_range or CAP_NET_RAW)");
        return failure(Reason::unavailable,
                       std::string("no echo requests (ping): ") + std::strerror(end.error));
    }
    if (!leaveBy(end.descriptor.number(), family, interfaceIndex)) {
        return failure(Reason::noInterface, interfaceName + " is gone");
    }
    const double startedAt = secondsSinceReference();
    const EchoWay way = wayTo(target, interfaceName, interfaceIndex);
    EchoRow row(end.descriptor.number(), end.raw, way, stay);
    if (std::optional<Error> error = row.run(until)) return *error;
    return Echo{interfaceName, target.text(), row.roundTrips(), startedAt};
}

}  // namespace wp
