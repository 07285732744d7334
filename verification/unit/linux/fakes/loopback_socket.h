#pragma once

#include <gtest/gtest.h>
#include <sys/socket.h>

#include "exchange/descriptor.h"
#include "linux/probe/ip_socket.h"

namespace wp {

/// A socket of a test's own at a place on loopback, which is closed with it.
class LoopbackSocket {
  public:
    /// For datagrams, at a free port of 127.0.0.1.
    static LoopbackSocket forDatagrams() {
        return {SOCK_DGRAM, SocketAddress::of(*IPAddress::fromText("127.0.0.1"), 0)};
    }
    /// For connections. \param port 0 for a free one \param queue how many more than one may wait to be accepted
    static LoopbackSocket listening(const char* address = "127.0.0.1", std::uint16_t port = 0,
                                    int queue = 8) {
        LoopbackSocket made(SOCK_STREAM, SocketAddress::of(*IPAddress::fromText(address), port));
        EXPECT_EQ(::listen(made.number(), queue), 0);
        return made;
    }

    int number() const { return socket_.number(); }
    const SocketAddress& place() const { return place_; }
    std::uint16_t port() const { return place_.port(); }

  private:
    LoopbackSocket(int type, const SocketAddress& place)
        : socket_(::socket(AF_INET, type | SOCK_CLOEXEC, 0)), place_(place) {
        EXPECT_EQ(::bind(number(), place_.raw(), place_.size), 0);
        ::getsockname(number(), reinterpret_cast<sockaddr*>(&place_.storage), &place_.size);
    }

    Descriptor socket_;
    SocketAddress place_;
};

}  // namespace wp
