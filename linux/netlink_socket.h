#pragma once

#include <linux/netlink.h>

#include <array>
#include <cstdint>
#include <memory>
#include <optional>
#include <vector>

#include "linux/stop_signal.h"
#include "service/bytes.h"

struct mnl_socket;

namespace wp {

/// A question to the kernel. It is small: names and channels of a scan are the most it carries.
class NetlinkRequest {
  public:
    /// @param type the message's type, for the kernel's Wi-Fi the number of its family
    NetlinkRequest(std::uint16_t type, std::uint16_t flags);
    NetlinkRequest(const NetlinkRequest&) = delete;

    /// The zeroed header that follows netlink's own; to be put before any attribute.
    template <class Header>
    Header& header() {
        return *static_cast<Header*>(extraHeader(sizeof(Header)));
    }

    void put(std::uint16_t type, Bytes content);
    void put(std::uint16_t type, std::uint32_t number);
    /// Attributes put until `endNest` are nested in this one.
    nlattr* beginNest(std::uint16_t type);
    void endNest(nlattr* nest);

    nlmsghdr& message() { return *header_; }

  private:
    void* extraHeader(std::size_t size);

    static constexpr std::size_t kSize = 4096;
    alignas(nlmsghdr) std::array<char, kSize> buffer_{};
    nlmsghdr* header_;
};

/// What the kernel answered.
struct NetlinkAnswer {
    int error = 0;                       ///< an errno, 0 when all went well
    std::vector<std::uint8_t> messages;  ///< as they came, one after another, without the end
};

/// What the kernel answers to one request, put together from what is received. *Any* thread, one at a time.
class GatheredAnswer {
  public:
    explicit GatheredAnswer(std::uint32_t sequence) : sequence_(sequence) {}

    /// Takes in what came; whether the answer is complete. Messages of other requests are passed over.
    bool take(Bytes messages);
    /// Whether what was listed changed meanwhile, so that one of it may be missing, or be there twice.
    bool changed() const { return changed_; }
    NetlinkAnswer& answer() { return answer_; }

  private:
    std::uint32_t sequence_;
    bool changed_ = false;
    NetlinkAnswer answer_;
};

/// A netlink socket. One thread at a time.
class NetlinkSocket {
  public:
    /// @param protocol `NETLINK_GENERIC` or `NETLINK_ROUTE`
    static Known<NetlinkSocket> open(int protocol);

    /// Sends the request and gathers the answer up to its end or acknowledgement. What changed while the kernel listed it
    /// is asked for again, a few times; where it changes all the time the last list has to do. The error is `ETIME` or
    /// `ECANCELED` when the wait for the answer ended.
    NetlinkAnswer ask(NetlinkRequest& request, const Until& until);

    /// Also receives what the group is told; returns whether that was possible.
    bool join(std::uint32_t group);
    /// The next messages that came, whatever they are; `error` as above.
    NetlinkAnswer receive(const Until& until);
    /// The same of what has come already; `EAGAIN` where nothing has.
    NetlinkAnswer receiveWaiting();

  private:
    struct Close {
        void operator()(mnl_socket* socket) const;
    };
    explicit NetlinkSocket(mnl_socket* socket);

    GatheredAnswer gather(std::uint32_t sequence, const Until& until);

    std::unique_ptr<mnl_socket, Close> socket_;
    std::unique_ptr<std::uint8_t[]> buffer_;  ///< not cleared: most answers touch little of it
    std::uint32_t sequence_ = 0;
};

}  // namespace wp
