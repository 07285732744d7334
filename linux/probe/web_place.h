#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace wp {

/// The longest URL that is taken from anybody, in bytes.
inline constexpr std::size_t kLongestUrl = 2048;

/// The parts of "http://HOST[:PORT][/PATH]", or the same with https.
struct WebPlace {
    bool secure = false;
    std::string
        host;  ///< without the brackets of an IPv6 address and its zone, which is another device's word
    std::uint16_t port = 80;
    std::string path;  ///< begins with "/", with the query; without a fragment
    bool operator==(const WebPlace&) const = default;

    /// "HOST[:PORT]" as a request names it: an IPv6 address in brackets, the scheme's own port left out.
    std::string authority() const;
    /// "SCHEME://HOST[:PORT]".
    std::string origin() const;
};

/// Nothing for any other form: another scheme, a user's name, blanks, bytes that are not printable ASCII.
/// *Any* thread.
std::optional<WebPlace> webPlace(std::string_view url);

/// The host of such a URL; empty for any other form.
std::string hostOf(std::string_view url);

/// The address that `reference`, found in the document at `base`, stands for (RFC 3986, 5.2): itself where it names a
/// scheme, else a place on the host of `base`. Bytes that no URL may hold are written as "%NN". Empty where `base` is
/// no web place, or what comes out is longer than `kLongestUrl`. *Any* thread.
std::string resolveReference(std::string_view base, std::string_view reference);

}  // namespace wp
