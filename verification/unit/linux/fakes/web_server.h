#pragma once

#include <gtest/gtest.h>
#include <stdlib.h>

#include <filesystem>
#include <memory>
#include <sstream>
#include <string>

#include "verification/unit/linux/fakes/child_process.h"

namespace wp {

/// The web server of web_server.py on loopback, with a certificate of its own for "host.example" and 127.0.0.1.
class WebServer {
  public:
    WebServer() {
        std::string pattern = ::testing::TempDir() + "/wpXXXXXX";
        folder_ = mkdtemp(pattern.data());
        const std::string make =
            "openssl req -x509 -newkey ec -pkeyopt ec_paramgen_curve:P-256 -nodes -days 2 -subj "
            "/CN=host.example "
            "-addext subjectAltName=DNS:host.example,IP:127.0.0.1 -keyout " +
            folder_ + "/key.pem -out " + certificate() + " 2>/dev/null";
        EXPECT_EQ(std::system(make.c_str()), 0);
        server_ = std::make_unique<ChildProcess>(
            std::vector<std::string>{"python3", WP_SOURCE_DIR "/verification/unit/linux/fakes/web_server.py",
                                     certificate(), folder_ + "/key.pem"});
        std::istringstream(server_->firstLine()) >> plainPort_ >> securePort_;
    }
    WebServer(const WebServer&) = delete;
    ~WebServer() { std::filesystem::remove_all(folder_); }

    std::string certificate() const { return folder_ + "/certificate.pem"; }
    const std::string& plainPort() const { return plainPort_; }
    std::string plain(const std::string& path, const std::string& host = "127.0.0.1") const {
        return "http://" + host + ":" + plainPort_ + path;
    }
    std::string secure(const std::string& path, const std::string& host = "127.0.0.1") const {
        return "https://" + host + ":" + securePort_ + path;
    }

  private:
    std::string folder_, plainPort_, securePort_;
    std::unique_ptr<ChildProcess> server_;
};

}  // namespace wp
