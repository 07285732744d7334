#pragma once

#include <gtest/gtest.h>
#include <openssl/ssl.h>
#include <signal.h>
#include <sys/socket.h>

#include <memory>
#include <string>
#include <thread>

#include "exchange/descriptor.h"
#include "verification/unit/linux/fakes/loopback_socket.h"

namespace wp {

/// A server on loopback that makes one connection secure and then sends nothing but new keys, one after the other, until
/// the client has gone, or it has sent more than any client bears.
class RestlessServer {
  public:
    RestlessServer(const std::string& certificate, const std::string& key)
        : context_(SSL_CTX_new(TLS_server_method()), SSL_CTX_free) {
        ::signal(SIGPIPE, SIG_IGN);  // the client goes whenever it wants
        EXPECT_EQ(SSL_CTX_use_certificate_file(context_.get(), certificate.c_str(), SSL_FILETYPE_PEM), 1);
        EXPECT_EQ(SSL_CTX_use_PrivateKey_file(context_.get(), key.c_str(), SSL_FILETYPE_PEM), 1);
        thread_ = std::thread([this] { run(); });
    }
    ~RestlessServer() {
        ::shutdown(listener_.number(), SHUT_RDWR);
        thread_.join();
    }

    std::uint16_t port() const { return listener_.port(); }

  private:
    void run() {
        constexpr int kMostKeys = 1'000'000;
        const Descriptor client(::accept4(listener_.number(), nullptr, nullptr, SOCK_CLOEXEC));
        const std::unique_ptr<SSL, decltype(&SSL_free)> stream(SSL_new(context_.get()), SSL_free);
        if (!client || SSL_set_fd(stream.get(), client.number()) != 1 || SSL_accept(stream.get()) != 1)
            return;
        for (int i = 0; i < kMostKeys; ++i)
            if (SSL_key_update(stream.get(), SSL_KEY_UPDATE_NOT_REQUESTED) != 1 ||
                SSL_do_handshake(stream.get()) != 1)
                return;
    }

    const LoopbackSocket listener_ = LoopbackSocket::listening();
    std::unique_ptr<SSL_CTX, decltype(&SSL_CTX_free)> context_;
    std::thread thread_;
};

}  // namespace wp
