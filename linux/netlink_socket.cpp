#include "linux/netlink_socket.h"

#include <libmnl/libmnl.h>

#include <algorithm>
#include <cerrno>
#include <cstring>

#include "linux/netlink_reader.h"

namespace wp {
namespace {

// The kernel makes its dump messages up to 32 KiB long where the reader has room for them.
constexpr std::size_t kReceiveSize = 32'768;
constexpr int kDumpAttempts = 4;

int errorOf(Wait wait) {
    return wait == Wait::stopped ? ECANCELED : ETIME;
}

/// The errno of an error, an acknowledgement or an end; ends without a number are well.
int statusIn(const NetlinkMessage& message) {
    return -Attributes::numberIn<std::int32_t>(
                message.payload.first(std::min<std::size_t>(message.payload.size(), 4)))
                .value_or(0);
}

}  // namespace

NetlinkRequest::NetlinkRequest(std::uint16_t type, std::uint16_t flags)
    : header_(mnl_nlmsg_put_header(buffer_.data())) {
    header_->nlmsg_type = type;
    header_->nlmsg_flags = static_cast<std::uint16_t>(NLM_F_REQUEST | NLM_F_ACK | flags);
}

void* NetlinkRequest::extraHeader(std::size_t size) {
    return mnl_nlmsg_put_extra_header(header_, size);
}

void NetlinkRequest::put(std::uint16_t type, Bytes content) {
    mnl_attr_put_check(header_, kSize, type, content.size(), content.data());
}

void NetlinkRequest::put(std::uint16_t type, std::uint32_t number) {
    mnl_attr_put_u32_check(header_, kSize, type, number);
}

nlattr* NetlinkRequest::beginNest(std::uint16_t type) {
    return mnl_attr_nest_start(header_, type);
}

void NetlinkRequest::endNest(nlattr* nest) {
    mnl_attr_nest_end(header_, nest);
}

void NetlinkSocket::Close::operator()(mnl_socket* socket) const {
    mnl_socket_close(socket);
}

NetlinkSocket::NetlinkSocket(mnl_socket* socket)
    : socket_(socket), buffer_(std::make_unique_for_overwrite<std::uint8_t[]>(kReceiveSize)) {}

Known<NetlinkSocket> NetlinkSocket::open(int protocol) {
    mnl_socket* const raw = mnl_socket_open2(protocol, SOCK_CLOEXEC | SOCK_NONBLOCK);
    if (raw == nullptr)
        return failure(Reason::unavailable, std::string("no netlink: ") + std::strerror(errno));
    NetlinkSocket socket(raw);
    if (mnl_socket_bind(raw, 0, MNL_SOCKET_AUTOPID) < 0) {
        return failure(Reason::unavailable, std::string("no netlink: ") + std::strerror(errno));
    }
    return socket;
}

bool NetlinkSocket::join(std::uint32_t group) {
    return mnl_socket_setsockopt(socket_.get(), NETLINK_ADD_MEMBERSHIP, &group, sizeof group) == 0;
}

NetlinkAnswer NetlinkSocket::receiveWaiting() {
    const ssize_t size = mnl_socket_recvfrom(socket_.get(), buffer_.get(), kReceiveSize);
    if (size < 0) return {errno, {}};
    return {0, {buffer_.get(), buffer_.get() + size}};
}

/// The kernel answers most questions while it is asked: what has come is taken before anything is waited for.
NetlinkAnswer NetlinkSocket::receive(const Until& until) {
    for (;;) {
        if (until.stop->raised()) return {ECANCELED, {}};
        NetlinkAnswer come = receiveWaiting();
        if (come.error != EAGAIN && come.error != EINTR) return come;
        const Wait wait = waitReadable(mnl_socket_get_fd(socket_.get()), until);
        if (wait != Wait::ready) return {errorOf(wait), {}};
    }
}

bool GatheredAnswer::take(Bytes messages) {
    Bytes rest = messages;
    for (Bytes before = rest; const auto message = takeNetlinkMessage(rest); before = rest) {
        if (message->sequence != sequence_) continue;  // of a question that was given up
        changed_ = changed_ || (message->flags & NLM_F_DUMP_INTR);
        if (message->type == NLMSG_ERROR || message->type == NLMSG_DONE) {
            answer_.error = statusIn(*message);
            return true;
        }
        answer_.messages.insert(answer_.messages.end(), before.begin(), rest.begin());
    }
    return false;
}

GatheredAnswer NetlinkSocket::gather(std::uint32_t sequence, const Until& until) {
    GatheredAnswer gathered(sequence);
    for (;;) {
        NetlinkAnswer part = receive(until);
        if (part.error != 0)
            gathered.answer() = std::move(part);
        else if (!gathered.take(part.messages))
            continue;
        return gathered;
    }
}

NetlinkAnswer NetlinkSocket::ask(NetlinkRequest& request, const Until& until) {
    for (int attempt = 1;; ++attempt) {
        request.message().nlmsg_seq = ++sequence_;
        if (mnl_socket_sendto(socket_.get(), &request.message(), request.message().nlmsg_len) < 0)
            return {errno, {}};
        GatheredAnswer gathered = gather(sequence_, until);
        const bool isWorthAnother = gathered.answer().error == 0 && gathered.changed();
        if (!isWorthAnother || attempt == kDumpAttempts) return std::move(gathered.answer());
    }
}

}  // namespace wp
