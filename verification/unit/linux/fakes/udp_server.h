#pragma once

#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>

#include <functional>
#include <optional>
#include <thread>
#include <vector>

#include "exchange/descriptor.h"
#include "linux/stop_signal.h"

namespace wp {

/// A server of datagrams on 127.0.0.1 that answers each request as the test says: with bytes, or not at all.
class UdpServer {
  public:
    using Message = std::vector<std::uint8_t>;
    using Answer = std::function<std::optional<Message>(const Message& request)>;

    /// Whether its answers come from where it was asked, or from another port.
    enum class Sender { itself, stranger };

    explicit UdpServer(Answer answer, Sender sender = Sender::itself)
        : socket_(::socket(AF_INET, SOCK_DGRAM | SOCK_CLOEXEC, 0)),
          other_(::socket(AF_INET, SOCK_DGRAM | SOCK_CLOEXEC, 0)),
          sender_(sender),
          answer_(std::move(answer)) {
        sockaddr_in place{};
        place.sin_family = AF_INET;
        place.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t size = sizeof place;
        ::bind(socket_.number(), reinterpret_cast<sockaddr*>(&place), size);
        ::getsockname(socket_.number(), reinterpret_cast<sockaddr*>(&place), &size);
        port_ = ntohs(place.sin_port);
        thread_ = std::thread([this] { run(); });
    }
    ~UdpServer() {
        stop_.raise();
        thread_.join();
    }

    std::uint16_t port() const { return port_; }

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

    Descriptor socket_, other_;
    Sender sender_;
    Answer answer_;
    StopSignal stop_;
    std::uint16_t port_ = 0;
    std::thread thread_;
};

}  // namespace wp
