#include "linux/probe/web_place.h"

#include <algorithm>
#include <charconv>

#include "service/ip_address.h"

namespace wp {
namespace {

constexpr std::uint16_t kPlainPort = 80, kSecurePort = 443;

bool isPrintable(char c) {
    return c > ' ' && c < 0x7F;
}

bool isLetter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

/// Takes the scheme off, whatever its case.
bool takeScheme(std::string_view& url, std::string_view scheme) {
    const auto same = [](char a, char b) { return a == b || (isLetter(a) && (a | 0x20) == b); };
    if (url.size() < scheme.size() ||
        !std::equal(scheme.begin(), scheme.end(), url.begin(), [same](char b, char a) { return same(a, b); }))
        return false;
    url.remove_prefix(scheme.size());
    return true;
}

bool readPort(std::string_view text, std::uint16_t& port) {
    const char* const end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, port);
    return error == std::errc() && stop == end && port != 0;
}

/// Takes "HOST[:PORT]" apart.
bool readAuthority(std::string_view text, WebPlace& place) {
    if (text.starts_with("[")) {
        const std::size_t end = text.find(']');
        const std::string_view inside = text.substr(1, end == text.npos ? end : end - 1);
        const auto address = IPAddress::fromText(inside);
        if (end == text.npos || !address || inside.find(':') == inside.npos) return false;
        place.host = inside.substr(0, inside.find('%'));
        text.remove_prefix(end + 1);
    } else {
        place.host = text.substr(0, text.find(':'));
        text.remove_prefix(place.host.size());
    }
    if (place.host.empty() || place.host.find_first_of("@[]\\") != std::string::npos) return false;
    return text.empty() || (text[0] == ':' && readPort(text.substr(1), place.port));
}

/// "SCHEME:" at the beginning (RFC 3986, 3.1).
bool namesScheme(std::string_view text) {
    const std::size_t colon = text.find(':');
    return colon != text.npos && isLetter(text[0]) &&
           std::all_of(text.begin(), text.begin() + static_cast<std::ptrdiff_t>(colon), [](char c) {
               return isLetter(c) || (c >= '0' && c <= '9') || c == '+' || c == '-' || c == '.';
           });
}

std::string withoutForeignBytes(std::string_view text) {
    constexpr const char* kDigits = "0123456789ABCDEF";
    std::string result;
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (isPrintable(c))
            result += c;
        else
            result += {'%', kDigits[byte >> 4], kDigits[byte & 15]};
    }
    return result;
}

/// A path whose parts "." and ".." are worked off; it begins with "/".
std::string withoutDots(std::string_view path) {
    std::string result;
    while (!path.empty()) {
        const std::size_t end = std::min(path.find('/', 1), path.size());
        const std::string_view part = path.substr(0, end);
        const bool isDot = part == "/.", isUp = part == "/..";
        if (isUp) result.resize(result.empty() ? 0 : result.rfind('/'));
        if (!isDot && !isUp) result += part;
        path.remove_prefix(end);
        if (path.empty() && (isDot || isUp)) result += '/';
    }
    return result;
}

/// The path and query on the host of `place` that a reference without scheme and host stands for.
std::string pathOf(const WebPlace& place, std::string_view reference) {
    if (reference.empty() || reference[0] == '#') return place.path;
    const std::string own = place.path.substr(0, place.path.find('?'));
    if (reference[0] == '?') return own + std::string(reference);
    const std::size_t query = std::min(reference.find_first_of("?#"), reference.size());
    const std::string folder = reference[0] == '/' ? "" : own.substr(0, own.rfind('/') + 1);
    return withoutDots(folder + std::string(reference.substr(0, query))) +
           std::string(reference.substr(query));
}

}  // namespace

std::string WebPlace::authority() const {
    const std::string name = host.find(':') == std::string::npos ? host : "[" + host + "]";
    return port == (secure ? kSecurePort : kPlainPort) ? name : name + ":" + std::to_string(port);
}

std::string WebPlace::origin() const {
    return (secure ? "https://" : "http://") + authority();
}

std::optional<WebPlace> webPlace(std::string_view url) {
    if (url.size() > kLongestUrl || !std::ranges::all_of(url, isPrintable)) return std::nullopt;
    WebPlace place;
    place.secure = takeScheme(url, "https://");
    if (!place.secure && !takeScheme(url, "http://")) return std::nullopt;
    if (place.secure) place.port = kSecurePort;
    url = url.substr(0, url.find('#'));
    const std::size_t end = std::min(url.find_first_of("/?"), url.size());
    if (!readAuthority(url.substr(0, end), place)) return std::nullopt;
    place.path = url.substr(end);
    if (!place.path.starts_with("/")) place.path.insert(0, "/");
    return place;
}

std::string hostOf(std::string_view url) {
    const auto place = webPlace(url);
    return place ? place->host : std::string();
}

std::string resolveReference(std::string_view base, std::string_view reference) {
    const auto place = webPlace(base);
    if (!place || reference.size() > kLongestUrl) return {};
    const std::string clean = withoutForeignBytes(reference);
    std::string whole;
    if (namesScheme(clean))
        whole = clean;
    else if (clean.starts_with("//"))
        whole = (place->secure ? "https:" : "http:") + clean;
    else
        whole = place->origin() + pathOf(*place, clean);
    return whole.size() <= kLongestUrl ? whole : std::string();
}

}  // namespace wp
