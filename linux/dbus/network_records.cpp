#include "linux/dbus/network_records.h"

#include <charconv>
#include <vector>

#include "linux/utc_time.h"

namespace wp {
namespace {

constexpr std::int64_t kReferenceAfterUnix = 978'307'200;  // 2001-01-01 00:00:00 UTC

std::optional<int> digit(char c) {
    if (c >= '0' && c <= '9') return c - '0';
    if (c >= 'a' && c <= 'f') return c - 'a' + 10;
    if (c >= 'A' && c <= 'F') return c - 'A' + 10;
    return std::nullopt;
}

using ByteList = std::vector<std::uint8_t>;

std::optional<NetworkName> nameOf(const ByteList& bytes) {
    if (bytes.empty() || bytes.size() > NetworkName::kMaximumSize) return std::nullopt;
    return NetworkName(bytes);
}

std::optional<ByteList> fromHexadecimal(std::string_view text) {
    ByteList bytes;
    if (text.size() % 2 != 0) return std::nullopt;
    for (std::size_t i = 0; i < text.size(); i += 2) {
        const auto high = digit(text[i]), low = digit(text[i + 1]);
        if (!high || !low) return std::nullopt;
        bytes.push_back(static_cast<std::uint8_t>(*high << 4 | *low));
    }
    return bytes;
}

/// What stands after a backslash; nothing for what the supplicant never writes.
std::optional<std::uint8_t> escaped(std::string_view text, std::size_t& at) {
    switch (text[at]) {
        case 'n':
            return '\n';
        case 'r':
            return '\r';
        case 't':
            return '\t';
        case 'e':
            return 0x1B;
        case '\\':
        case '"':
            return static_cast<std::uint8_t>(text[at]);
        case 'x':
            break;
        default:
            return std::nullopt;
    }
    if (at + 2 >= text.size()) return std::nullopt;
    const auto bytes = fromHexadecimal(text.substr(at + 1, 2));
    at += 2;
    return bytes ? std::optional((*bytes)[0]) : std::nullopt;
}

std::optional<ByteList> fromEscaped(std::string_view text) {
    ByteList bytes;
    for (std::size_t at = 0; at < text.size(); ++at) {
        if (text[at] != '\\') {
            bytes.push_back(static_cast<std::uint8_t>(text[at]));
            continue;
        }
        if (++at == text.size()) return std::nullopt;
        const auto byte = escaped(text, at);
        if (!byte) return std::nullopt;
        bytes.push_back(*byte);
    }
    return bytes;
}

bool has(std::string_view words, std::string_view word) {
    return (" " + std::string(words) + " ").find(" " + std::string(word) + " ") != std::string::npos;
}

bool contains(std::string_view words, std::string_view part) {
    return words.find(part) != words.npos;
}

}  // namespace

Date dateFromUnix(std::int64_t seconds) {
    return {static_cast<double>(seconds - kReferenceAfterUnix)};
}

std::optional<Date> dateFromText(std::string_view text) {
    constexpr std::string_view kForm = "dddd-dd-ddTdd:dd:ddZ";
    if (text.size() != kForm.size()) return std::nullopt;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const bool fits = kForm[i] == 'd' ? text[i] >= '0' && text[i] <= '9' : text[i] == kForm[i];
        if (!fits) return std::nullopt;
    }
    const auto part = [text](std::size_t at, std::size_t length) {
        int value = 0;
        std::from_chars(text.data() + at, text.data() + at + length, value);
        return value;
    };
    const auto time = unixTime({part(0, 4), part(5, 2), part(8, 2), part(11, 2), part(14, 2), part(17, 2)});
    return time ? std::optional(dateFromUnix(*time)) : std::nullopt;
}

BusByteTexts namesCalled(const NetworkName& named) {
    const Bytes bytes = named.bytes();
    return {{bytes.begin(), bytes.end()}, {}};
}

std::optional<NetworkName> nameFromSupplicant(std::string_view text) {
    const bool quoted = text.size() >= 2 && text.back() == '"';
    if (quoted && text.front() == '"') {
        const std::string_view inner = text.substr(1, text.size() - 2);
        return nameOf({inner.begin(), inner.end()});
    }
    std::optional<ByteList> bytes;
    if (quoted && text.size() >= 3 && text.starts_with("P\""))
        bytes = fromEscaped(text.substr(2, text.size() - 3));
    else
        bytes = fromHexadecimal(text);
    return bytes ? nameOf(*bytes) : std::nullopt;
}

SavedSecurity securityFromSupplicant(std::string_view keyManagement, std::string_view protocols,
                                     SupplicantSecrets secrets) {
    const bool personal = contains(keyManagement, "PSK"), byName = contains(keyManagement, "EAP");
    if ((byName && (!personal || secrets.eapMethods)) || has(keyManagement, "IEEE8021X"))
        return SavedSecurity::enterprise;
    if (personal) {
        const bool onlyFirst = has(protocols, "WPA") && !has(protocols, "RSN") && !has(protocols, "WPA2");
        return onlyFirst ? SavedSecurity::wpaPersonal : SavedSecurity::wpa2Personal;
    }
    if (contains(keyManagement, "SAE")) return SavedSecurity::sae;
    if (has(keyManagement, "OWE")) return SavedSecurity::owe;
    if (has(keyManagement, "NONE")) return secrets.wepKey ? SavedSecurity::wep : SavedSecurity::open;
    return SavedSecurity::unknown;
}

}  // namespace wp
