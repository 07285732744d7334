#pragma once

#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>

#include <functional>
#include <optional>
#include <thread>
#include <vector>

#include "linux/stop_signal.h"
#include "service/ip_address.h"
#include "verification/unit/linux/fakes/loopback_socket.h"

namespace wp {

inline const IPAddress kHere = *IPAddress::fromText("127.0.0.1");

/// A server of datagrams there that answers each request as the test says: with bytes, or not at all.
class UdpServer {
  public:
    using Message = std::vector<std::uint8_t>;
    using Answer = std::function<std::optional<Message>(const Message& request)>;

    /// Whether its answers come from where it was asked, or from another port.
    enum class Sender { itself, stranger };

    explicit UdpServer(Answer answer, Sender sender = Sender::itself)
        : sender_(sender), answer_(std::move(answer)) {
        thread_ = std::thread([this] { run(); });
    }
    ~UdpServer() {
        stop_.raise();
        thread_.join();
    }

    std::uint16_t port() const { return socket_.port(); }

  private:
    void run() {
        while (true) {
            pollfd entries[] = {{socket_.number(), POLLIN, 0}, {stop_.descriptor(), POLLIN, 0}};
            ::poll(entries, 2, -1);
            if (entries[1].revents != 0) return;
            Message request(4096);
            sockaddr_in from{};
            socklen_t size = sizeof from;
            auto* place = reinterpret_cast<sockaddr*>(&from);
            const ssize_t count =
                ::recvfrom(socket_.number(), request.data(), request.size(), 0, place, &size);
            if (count < 0) continue;
            request.resize(static_cast<std::size_t>(count));
            if (const auto message = answer_(request))
                (void)::sendto(sender_ == Sender::itself ? socket_.number() : other_.number(),
                               message->data(), message->size(), 0, place, size);
        }
    }

    const LoopbackSocket socket_ = LoopbackSocket::forDatagrams();
    const LoopbackSocket other_ = LoopbackSocket::forDatagrams();
    Sender sender_;
    Answer answer_;
    StopSignal stop_;
    std::thread thread_;
};

}  // namespace wp
