#pragma once

#include <string>
#include <variant>
#include <vector>

#include "exchange/json_reader.h"
#include "exchange/object_reader.h"
#include "service/settings.h"

namespace wp {

/// Whom the tests contact beyond the local network. A test whose endpoint is the empty text cannot tell.
struct Endpoints {
    std::string pingIPv4 = "9.9.9.9";
    std::string pingIPv6 = "2620:fe::9";
    std::string name = "example.com";  ///< asked for where there is no wildcard zone
    std::string nameWildcard;          ///< a zone that answers to every name in it
    /// Answer with status 204 and nothing else where nobody interferes.
    std::string portalPlain = "http://cp.cloudflare.com/generate_204";
    std::string portalSecure = "https://cp.cloudflare.com/generate_204";
    std::string vendorHost = "example.com:443";
    std::string vendorUrl = "https://example.com/";
    std::string vendorBodyPrefix = "<!doctype html>";
    std::string stun = "stun.cloudflare.com:3478";
    /// A file of certificates in place of the system's, for services of one's own.
    std::string certificateAuthorities;
};

/// What a device maker, an operator or a user sets in place of the defaults.
struct Config {
    Endpoints endpoints;
    Thresholds thresholds;
    Vendors vendors;
    Flags capabilities;             ///< the device's, by name; the host asks for them
    std::string peerLinkIndicator;  ///< a file that holds 1 while the maker's peer link is in real-time mode

    /// What the verdicts go by.
    Settings settings() const { return {thresholds, vendors, {endpoints.vendorBodyPrefix}}; }

    /// The defaults; the makers in them are examples that no device matches.
    static Config defaults();
};

/// Takes over what the JSON text sets: an object with the objects "endpoints", "vendors", "thresholds" and
/// "capabilities", each of which may be left out, as may each key in them. Refused, with the place: unknown
/// keys, values of another kind or beyond their bounds. *Any* thread.
std::optional<Refusal> applyConfig(std::string_view json, Config& config);

/// Where configurations lie: the makers' data, the system's and the user's. \param home the user's folder of
/// configurations; empty: none
std::vector<std::string> configFiles(const std::string& home, const std::string& root = "");

/// The defaults, with the files over them in their order. A file that is not there is left out, unless it is
/// the one `named`. \returns the configuration, or one line: file, place and reason.
std::variant<Config, std::string> loadConfig(const std::vector<std::string>& files, const std::string& named);

/// What the host is told, in the form in which a configuration sets it: the capabilities, all endpoints and all
/// thresholds.
DictionaryPointer toldOf(const Config& config);

/// "HOST:PORT" in its parts; a host that is an IPv6 address stands in brackets. Nothing for any other form.
struct HostAndPort {
    std::string host;
    std::uint16_t port = 0;
};
std::optional<HostAndPort> hostAndPort(std::string_view text);

}  // namespace wp
