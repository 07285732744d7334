#pragma once

#include <memory>
#include <span>
#include <string>
#include <string_view>

#include "exchange/descriptor.h"
#include "service/reachability.h"

namespace wp {

/// What became of a step on a stream that never blocks.
enum class StreamStep { done, needsRead, needsWrite, closed, failed };

/// A connection, made secure or not. Owner's thread.
class WebStream {
  public:
    explicit WebStream(Descriptor connection);
    ~WebStream();
    WebStream(const WebStream&) = delete;

    int descriptor() const { return connection_.number(); }

    /// Goes on with making the connection secure, to be called until it is `done`. The certificate must hold for the
    /// host, a name or an address, by the authorities of the system or of a file or folder in their place. The library
    /// writes without regard to SIGPIPE: the program has to ignore it.
    StreamStep secure(const std::string& host, const std::string& authorities);
    /// Writes from the beginning of `bytes` and takes off what was written.
    StreamStep write(std::string_view& bytes);
    /// Reads into the buffer; `size` is how much when it is `done`.
    StreamStep read(std::span<char> buffer, std::size_t& size);

    /// Why the certificate of the other end does not hold; `none` where it does, or there was none to judge.
    CertificateFault fault() const { return fault_; }
    /// Whether nobody could be found by whom to judge a certificate.
    bool lacksAuthorities() const { return lacksAuthorities_; }
    /// The reason behind `failed`.
    const std::string& why() const { return why_; }

  private:
    struct Secure;

    bool begin(const std::string& host, const std::string& authorities);
    void judge(long verified, const std::string& authorities);
    StreamStep outcomeOf(int result);
    StreamStep outcomeOfSystem();

    Descriptor connection_;
    std::unique_ptr<Secure> secure_;
    CertificateFault fault_ = CertificateFault::none;
    bool lacksAuthorities_ = false;
    std::string why_;
};

}  // namespace wp
