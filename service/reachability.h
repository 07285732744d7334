#pragma once

#include <chrono>
#include <optional>
#include <string>
#include <vector>

#include "service/ip_address.h"
#include "service/outcome.h"

namespace wp {

/// One of the link's name servers, asked by itself.
struct NameServerAnswer {
    IPAddress server;
    /// "NOERROR", "NODATA", "NXDOMAIN", "SERVFAIL", "REFUSED", "FORMERR", "NOTIMP"; or, without an answer, "timeout"
    /// or "unreachable".
    std::string code;
    bool answered = false;
    double took = 0;  ///< ms
};

/// What became of a name that the link's own name servers were asked for.
struct NameAnswer {
    std::string name;
    std::vector<IPAddress> addresses;
    std::string why;  ///< where there is no address: what the servers said
    std::chrono::milliseconds took{0};
    std::vector<NameServerAnswer> servers{};  ///< the same question to each server, for the details alone
    bool heard = true;  ///< whether a server said anything at all, or there was none to be asked
};

/// Over which families an interface leads beyond its own network.
struct FamiliesOut {
    bool ipv4 = true;
    bool ipv6 = true;
};

/// Where the host of that name can be asked. Filters lead a name nowhere by an address that means this device itself
/// (0.0.0.0, 127.0.0.1), where something quite different may answer: such addresses are left out. *Any* thread.
std::vector<IPAddress> placesOf(const NameAnswer& answer);
/// Why there is no such place.
std::string whyNowhere(const NameAnswer& answer);

/// Test 7: whether a name outside resolves. Only an address that can lead outside counts: gateways that show
/// their own page answer with a private one.
Outcome resolvesNames(const Known<NameAnswer>& answer);

/// How long each step of a request took, in ms; absent where it was not reached, or there is none.
struct ContactSteps {
    std::optional<double> connect;    ///< to the server
    std::optional<double> secure;     ///< TLS on it
    std::optional<double> firstByte;  ///< of the answer, after the request
};

/// Why a certificate does not hold.
enum class CertificateFault {
    none,
    notYetValid,
    expired,
    wrongHost,
    selfSigned,
    unknownIssuer,
    revoked,
    other
};

/// What became of a connection to the vendor's service.
struct ServiceContact {
    enum class End {
        reached,  ///< connected and, over TLS, with a certificate that holds; what was asked for is answered
        failed,   ///< no address, no connection, or one that broke before there was an answer
        badCertificate,  ///< connected, but the certificate does not hold
    };
    End end = End::failed;
    std::string why;   ///< of a failure, or of a body that is not whole
    int status = 0;    ///< of HTTP
    std::string body;  ///< as far as it came, at most 64 KiB
    ContactSteps steps{};
    CertificateFault fault = CertificateFault::none;
    std::optional<IPAddress> server{};
    std::optional<std::int64_t> clockOffset{};  ///< s by which this device is ahead of the answer's date
};

/// What counts as the vendor's content: status 204, or 200 with a body that begins with the text.
struct ExpectedContent {
    std::string bodyPrefix;
};

/// Whether the device's clock can be right: not before the day on which the program was built.
struct ClockCheck {
    bool beforeBuild = false;
};

/// Test 9: whether the vendor's service can be reached, up to a secure connection. A certificate that does
/// not hold on a device whose clock is wrong says nothing about the network.
Outcome reachesVendor(const Known<ServiceContact>& contact, const ClockCheck& clock);
/// Test 11: whether the vendor's content arrives unaltered. Its beginning tells, however the connection ended: many
/// servers end one without the word that ends it.
Outcome retrievesFromVendor(const Known<ServiceContact>& contact, const ExpectedContent& expected,
                            const ClockCheck& clock);

}  // namespace wp
