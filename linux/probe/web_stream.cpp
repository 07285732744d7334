#include "linux/probe/web_stream.h"

#include <openssl/err.h>
#include <openssl/ssl.h>
#include <openssl/x509v3.h>
#include <sys/socket.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <filesystem>

#include "service/ip_address.h"

namespace wp {
namespace {

/// The folder lets the few authorities that are needed be read, a file would all be read.
const std::string kSystemsAuthorities = "/etc/ssl/certs";
constexpr const char* kClosed = "the connection was closed";

struct Release {
    void operator()(SSL_CTX* context) const { SSL_CTX_free(context); }
    void operator()(SSL* connection) const { SSL_free(connection); }
};

CertificateFault faultOfCode(long code) {
    switch (code) {
        case X509_V_OK:
            return CertificateFault::none;
        case X509_V_ERR_HOSTNAME_MISMATCH:
        case X509_V_ERR_IP_ADDRESS_MISMATCH:
            return CertificateFault::wrongHost;
        case X509_V_ERR_CERT_NOT_YET_VALID:
            return CertificateFault::notYetValid;
        case X509_V_ERR_CERT_HAS_EXPIRED:
            return CertificateFault::expired;
        case X509_V_ERR_DEPTH_ZERO_SELF_SIGNED_CERT:
        case X509_V_ERR_SELF_SIGNED_CERT_IN_CHAIN:
            return CertificateFault::selfSigned;
        case X509_V_ERR_UNABLE_TO_GET_ISSUER_CERT:
        case X509_V_ERR_UNABLE_TO_GET_ISSUER_CERT_LOCALLY:
        case X509_V_ERR_UNABLE_TO_VERIFY_LEAF_SIGNATURE:
            return CertificateFault::unknownIssuer;
        case X509_V_ERR_CERT_REVOKED:
            return CertificateFault::revoked;
        default:
            return CertificateFault::other;
    }
}

std::string lastReason() {
    const char* const reason = ERR_reason_error_string(ERR_peek_last_error());
    return reason != nullptr ? reason : "no reason given";
}

/// Who is trusted; false where a file cannot be read.
bool setAuthorities(SSL_CTX* context, const std::string& place) {
    std::error_code failed;
    return std::filesystem::is_regular_file(place, failed)
               ? SSL_CTX_load_verify_file(context, place.c_str()) == 1
               : SSL_CTX_load_verify_dir(context, place.c_str()) == 1;
}

/// Whether any certificate lies there: a folder holds them as "9d66eef0.0".
bool holdsAuthorities(const std::string& place) {
    constexpr std::size_t kHash = 8;
    std::error_code failed;
    if (std::filesystem::is_regular_file(place, failed)) return true;
    for (std::filesystem::directory_iterator each(place, failed), end; !failed && each != end;
         each.increment(failed)) {
        const std::string name = each->path().filename();
        if (name.size() > kHash + 1 && name.find_first_not_of("0123456789abcdef") == kHash &&
            name[kHash] == '.' && std::filesystem::exists(each->path(), failed))
            return true;
    }
    return false;
}

/// Whom the certificate must be for.
bool setHost(SSL* connection, const std::string& host) {
    if (const auto address = IPAddress::fromText(host))
        return X509_VERIFY_PARAM_set1_ip(SSL_get0_param(connection), address->bytes().data(),
                                         address->bytes().size()) == 1;
    SSL_set_hostflags(connection, X509_CHECK_FLAG_NO_PARTIAL_WILDCARDS);  // RFC 9525, 6.3
    // The macro for the last call casts in C's way.
    return SSL_set1_host(connection, host.c_str()) == 1 &&
           SSL_ctrl(connection, SSL_CTRL_SET_TLSEXT_HOSTNAME, TLSEXT_NAMETYPE_host_name,
                    const_cast<char*>(host.c_str())) == 1;
}

}  // namespace

struct WebStream::Secure {
    std::unique_ptr<SSL_CTX, Release> context;
    std::unique_ptr<SSL, Release> connection;

    bool makeContext() {
        context.reset(SSL_CTX_new(TLS_client_method()));
        if (!context || SSL_CTX_set_min_proto_version(context.get(), TLS1_2_VERSION) != 1) return false;
        SSL_CTX_set_verify(context.get(), SSL_VERIFY_PEER, nullptr);
        // An authority that the configuration names need not be the last of its chain.
        X509_VERIFY_PARAM_set_flags(SSL_CTX_get0_param(context.get()), X509_V_FLAG_PARTIAL_CHAIN);
        SSL_CTX_set_options(context.get(), SSL_OP_NO_RENEGOTIATION);
        // A step ends with each record: one with no data in it, of which a server may send any number, must not keep
        // the library from coming back to whoever watches the deadline.
        SSL_CTX_clear_mode(context.get(), SSL_MODE_AUTO_RETRY);
        return true;
    }

    bool makeConnection(int descriptor, const std::string& host) {
        connection.reset(SSL_new(context.get()));
        if (!connection || !setHost(connection.get(), host) || SSL_set_fd(connection.get(), descriptor) != 1)
            return false;
        SSL_set_connect_state(connection.get());
        return true;
    }
};

WebStream::WebStream(Descriptor connection) : connection_(std::move(connection)) {}

WebStream::~WebStream() = default;

StreamStep WebStream::secure(const std::string& host, const std::string& authorities) {
    const std::string& place = authorities.empty() ? kSystemsAuthorities : authorities;
    if (!secure_ && !begin(host, place)) return StreamStep::failed;
    ERR_clear_error();
    const StreamStep step = outcomeOf(SSL_do_handshake(secure_->connection.get()));
    const long verified = SSL_get_verify_result(secure_->connection.get());
    if (step == StreamStep::failed && verified != X509_V_OK)
        judge(verified, place);
    else if (step == StreamStep::failed)
        why_.insert(0, "no secure connection: ");
    return step;
}

/// Makes ready for the first step.
bool WebStream::begin(const std::string& host, const std::string& authorities) {
    ERR_clear_error();
    secure_ = std::make_unique<Secure>();
    const bool isReady = secure_->makeContext();
    lacksAuthorities_ = isReady && !setAuthorities(secure_->context.get(), authorities);
    if (isReady && !lacksAuthorities_ && secure_->makeConnection(connection_.number(), host)) return true;
    why_ =
        (lacksAuthorities_ ? "no certificates of authorities in " + authorities + ": " : "") + lastReason();
    return false;
}

/// What a certificate that was not accepted means.
void WebStream::judge(long verified, const std::string& authorities) {
    const CertificateFault fault = faultOfCode(verified);
    const bool isStranger = fault == CertificateFault::selfSigned || fault == CertificateFault::unknownIssuer;
    lacksAuthorities_ = isStranger && !holdsAuthorities(authorities);
    if (lacksAuthorities_) {
        why_ = "no certificates of authorities in " + authorities;
        return;
    }
    fault_ = fault;
    why_ = std::string("the certificate does not hold: ") + X509_verify_cert_error_string(verified);
}

StreamStep WebStream::write(std::string_view& bytes) {
    if (secure_) {
        ERR_clear_error();
        std::size_t written = 0;
        const int result = SSL_write_ex(secure_->connection.get(), bytes.data(), bytes.size(), &written);
        bytes.remove_prefix(written);
        return outcomeOf(result);
    }
    const ssize_t written = ::send(connection_.number(), bytes.data(), bytes.size(), MSG_NOSIGNAL);
    if (written < 0) return errno == EAGAIN || errno == EINTR ? StreamStep::needsWrite : outcomeOfSystem();
    bytes.remove_prefix(static_cast<std::size_t>(written));
    return StreamStep::done;
}

StreamStep WebStream::read(std::span<char> buffer, std::size_t& size) {
    size = 0;
    if (secure_) {
        ERR_clear_error();
        return outcomeOf(SSL_read_ex(secure_->connection.get(), buffer.data(), buffer.size(), &size));
    }
    const ssize_t received = ::recv(connection_.number(), buffer.data(), buffer.size(), 0);
    if (received == 0) return StreamStep::closed;
    if (received < 0) return errno == EAGAIN ? StreamStep::needsRead : outcomeOfSystem();
    size = static_cast<std::size_t>(received);
    return StreamStep::done;
}

StreamStep WebStream::outcomeOfSystem() {
    if (errno == EINTR) return StreamStep::needsRead;
    why_ = std::strerror(errno);
    return StreamStep::failed;
}

/// The library's word on a step that it has just taken.
StreamStep WebStream::outcomeOf(int result) {
    const int systems = errno;
    switch (SSL_get_error(secure_->connection.get(), result)) {
        case SSL_ERROR_NONE:
            return StreamStep::done;
        case SSL_ERROR_WANT_READ:
            return StreamStep::needsRead;
        case SSL_ERROR_WANT_WRITE:
            return StreamStep::needsWrite;
        case SSL_ERROR_ZERO_RETURN:
            return StreamStep::closed;
        case SSL_ERROR_SYSCALL:
            why_ = systems != 0 ? std::strerror(systems) : kClosed;
            return StreamStep::failed;
        default:
            // A connection that ends without the word that ends a secure one may have been cut (RFC 9112, 9.8).
            why_ = ERR_GET_REASON(ERR_peek_last_error()) == SSL_R_UNEXPECTED_EOF_WHILE_READING ? kClosed
                                                                                               : lastReason();
            return StreamStep::failed;
    }
}

}  // namespace wp
