#include "service/network_name.h"

#include <algorithm>

namespace wp {
namespace {

constexpr std::size_t kEscapeSize = 4;  // \xNN

/// The length of the valid UTF-8 sequence at the front, 0 where there is none. Overlong forms, surrogates and
/// numbers above U+10FFFF are not valid.
std::size_t validSequence(Bytes bytes) {
    const std::uint8_t lead = bytes[0];
    if (lead < 0x80) return 1;
    const std::size_t length = lead < 0xC2 ? 0 : lead < 0xE0 ? 2 : lead < 0xF0 ? 3 : lead < 0xF5 ? 4 : 0;
    if (length == 0 || bytes.size() < length) return 0;
    const std::uint8_t low = lead == 0xE0 ? 0xA0 : lead == 0xF0 ? 0x90 : 0x80;
    const std::uint8_t high = lead == 0xED ? 0x9F : lead == 0xF4 ? 0x8F : 0xBF;
    if (bytes[1] < low || bytes[1] > high) return 0;
    const auto continues = [](std::uint8_t byte) { return (byte & 0xC0) == 0x80; };
    return std::all_of(bytes.begin() + 2, bytes.begin() + static_cast<std::ptrdiff_t>(length), continues)
               ? length
               : 0;
}

std::optional<std::uint8_t> hexDigit(std::uint8_t digit) {
    if (digit >= '0' && digit <= '9') return static_cast<std::uint8_t>(digit - '0');
    if (digit >= 'A' && digit <= 'F') return static_cast<std::uint8_t>(digit - 'A' + 10);
    return std::nullopt;
}

/// The byte that the escape at the front stands for, nothing where there is none.
std::optional<std::uint8_t> escapedByte(Bytes bytes) {
    if (bytes.size() < kEscapeSize || bytes[0] != '\\' || bytes[1] != 'x') return std::nullopt;
    const std::optional<std::uint8_t> high = hexDigit(bytes[2]);
    const std::optional<std::uint8_t> low = hexDigit(bytes[3]);
    if (!high || !low) return std::nullopt;
    return static_cast<std::uint8_t>(*high << 4 | *low);
}

void appendEscape(std::string& text, std::uint8_t byte) {
    static constexpr char kDigits[] = "0123456789ABCDEF";
    text += "\\x";
    text += kDigits[byte >> 4];
    text += kDigits[byte & 15];
}

Bytes bytesOf(std::string_view text) {
    return {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()};
}

}  // namespace

NetworkName::NetworkName(Bytes bytes)
    : size_(static_cast<std::uint8_t>(std::min(bytes.size(), kMaximumSize))) {
    std::copy_n(bytes.begin(), size_, bytes_.begin());
}

bool NetworkName::absent() const {
    return std::ranges::all_of(bytes(), [](std::uint8_t byte) { return byte == 0; });
}

std::string textFromName(const NetworkName& name) {
    std::string text;
    for (Bytes rest = name.bytes(); !rest.empty();) {
        const std::size_t length = validSequence(rest);
        if (length == 0 || escapedByte(rest)) {
            appendEscape(text, rest[0]);
            rest = rest.subspan(1);
        } else {
            text.append(rest.begin(), rest.begin() + static_cast<std::ptrdiff_t>(length));
            rest = rest.subspan(length);
        }
    }
    return text;
}

std::optional<NetworkName> nameFromText(std::string_view text) {
    std::array<std::uint8_t, NetworkName::kMaximumSize> bytes;
    std::size_t size = 0;
    for (Bytes rest = bytesOf(text); !rest.empty();) {
        if (size == bytes.size()) return std::nullopt;
        const std::optional<std::uint8_t> escaped = escapedByte(rest);
        bytes[size++] = escaped.value_or(rest[0]);
        rest = rest.subspan(escaped ? kEscapeSize : 1);
    }
    return NetworkName(Bytes(bytes.data(), size));
}

bool optsOutOfTests(const NetworkName& name) {
    static constexpr std::string_view kSuffix = "_nomap";
    const Bytes bytes = name.bytes();
    if (bytes.size() < kSuffix.size()) return false;
    return std::ranges::equal(bytes.last(kSuffix.size()), kSuffix, [](std::uint8_t byte, char wanted) {
        return (byte >= 'A' && byte <= 'Z' ? byte + ('a' - 'A') : byte) == wanted;
    });
}

}  // namespace wp
