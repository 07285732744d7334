#pragma once

#include <gtest/gtest.h>
#include <openssl/pem.h>
#include <openssl/x509.h>
#include <stdlib.h>

#include <memory>
#include <optional>
#include <sstream>
#include <string>

#include "verification/unit/fakes/temporary_folder.h"
#include "verification/unit/linux/fakes/child_process.h"
#include "verification/unit/places.h"

namespace wp {

/// The web server of web_server.py on loopback, with a certificate of its own for "host.example", 127.0.0.1, and
/// "wild*.host.example", which no name may be matched with.
class WebServer {
  public:
    /// When the certificate begins and ends to hold, in s from now.
    struct Validity {
        long from, to;
    };

    explicit WebServer(std::optional<Validity> validity = std::nullopt) {
        const std::string make =
            "openssl req -x509 -newkey ec -pkeyopt ec_paramgen_curve:P-256 -nodes -days 2 -subj "
            "/CN=host.example "
            "-addext subjectAltName=DNS:host.example,DNS:wild*.host.example,IP:127.0.0.1 -keyout " +
            key() + " -out " + certificate() + " 2>/dev/null";
        EXPECT_EQ(std::system(make.c_str()), 0);
        if (validity) renew(*validity);
        server_ = std::make_unique<ChildProcess>(std::vector<std::string>{
            "python3", sourceFolder() + "/verification/unit/linux/fakes/web_server.py", certificate(),
            key()});
        std::istringstream(server_->firstLine()) >> plainPort_ >> securePort_;
    }
    WebServer(const WebServer&) = delete;

    std::string certificate() const { return folder_ / "certificate.pem"; }
    std::string key() const { return folder_ / "key.pem"; }
    const std::string& plainPort() const { return plainPort_; }
    std::string plain(const std::string& path, const std::string& host = "127.0.0.1") const {
        return "http://" + host + ":" + plainPort_ + path;
    }
    std::string secure(const std::string& path, const std::string& host = "127.0.0.1") const {
        return "https://" + host + ":" + securePort_ + path;
    }

  private:
    /// Signs the certificate once more, for another time.
    void renew(const Validity& validity) const {
        BIO* const keyFile = BIO_new_file(key().c_str(), "r");
        BIO* file = BIO_new_file(certificate().c_str(), "r");
        EVP_PKEY* const signer = PEM_read_bio_PrivateKey(keyFile, nullptr, nullptr, nullptr);
        X509* const signed_ = PEM_read_bio_X509(file, nullptr, nullptr, nullptr);
        BIO_free(file);
        X509_gmtime_adj(X509_getm_notBefore(signed_), validity.from);
        X509_gmtime_adj(X509_getm_notAfter(signed_), validity.to);
        EXPECT_NE(X509_sign(signed_, signer, EVP_sha256()), 0);
        file = BIO_new_file(certificate().c_str(), "w");
        EXPECT_EQ(PEM_write_bio_X509(file, signed_), 1);
        BIO_free(file);
        BIO_free(keyFile);
        X509_free(signed_);
        EVP_PKEY_free(signer);
    }

    fakes::TemporaryFolder folder_;
    std::string plainPort_, securePort_;
    std::unique_ptr<ChildProcess> server_;
};

}  // namespace wp
