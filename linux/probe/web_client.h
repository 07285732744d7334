#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "linux/stop_signal.h"
#include "service/ip_address.h"
#include "service/reachability.h"

namespace wp {

/// One request. It follows no redirect, goes through no proxy, and takes a connection of its own. A body is read with
/// status 200 alone; nobody asks for that of another.
struct WebRequest {
    std::string url;
    std::string interfaceName;         ///< empty: any
    std::vector<IPAddress> addresses;  ///< of the URL's host; empty: the URL holds an address itself
    std::string whyNoAddress = "the name of its host has no address";
    std::vector<std::string> headers;  ///< "Name: value"
    std::optional<std::string> post;   ///< a body to be sent
    bool connectOnly = false;          ///< ends with the connection, secure where the URL is
    std::size_t longestBody = 64U << 10;
    /// A file of certificates, or a folder of them under the names of their hashes, in place of the system's.
    std::string authorities;
};

/// What became of it.
struct WebAnswer {
    enum class End {
        answered,
        failed,
        badCertificate,
        noAuthorities,  ///< there was nobody on this device to judge a certificate by
    };
    /// How far the body came.
    enum class Body {
        whole,   ///< to its end, or to the request's bound
        late,    ///< the deadline came before its end
        cutOff,  ///< the connection ended before it, or made no sense
    };
    End end = End::failed;
    std::string why;  ///< of a failure, or of a body that is not whole
    int status = 0;
    Body bodyCame = Body::whole;
    std::string body;      ///< as far as it came, up to the request's bound
    std::string location;  ///< where a redirect leads, as a whole URL of http or https; empty for any other
    std::optional<IPAddress> server;
    ContactSteps steps;
    CertificateFault fault = CertificateFault::none;
    std::optional<std::int64_t> clockOffset;  ///< s by which this device is ahead of the answer's "Date"
};

/// Called after each answer with all answers so far; true ends the others at once, as failed.
using Conclusive = std::function<bool(const std::vector<std::optional<WebAnswer>>& answers)>;

/// Runs the requests at once. An answer whose head has come counts with as much of its body as has come by the deadline,
/// or before the connection broke. An error is only that all was stopped, or that nothing may go over the interface. *Any*
/// thread.
Known<std::vector<WebAnswer>> runWebRequests(const std::vector<WebRequest>& requests, const Until& until,
                                             const Conclusive& conclusive = nullptr);

}  // namespace wp
