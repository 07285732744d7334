#include "service/ip_address.h"

#include <algorithm>
#include <charconv>
#include <vector>

namespace wp {
namespace {

/// Whether the first `length` bits of `bytes` are those of `prefix`.
bool startsWith(Bytes bytes, std::initializer_list<std::uint8_t> prefix, unsigned length) {
    const Bytes wanted(prefix.begin(), prefix.size());
    for (unsigned bit = 0; bit < length; bit += 8) {
        const unsigned left = std::min(8U, length - bit);
        const unsigned mask = (0xFFU << (8 - left)) & 0xFFU;
        if (((bytes[bit / 8] ^ wanted[bit / 8]) & mask) != 0) return false;
    }
    return true;
}

/// A number of `base` that takes up the whole text, of at most `digits` digits.
std::optional<unsigned> number(std::string_view text, int base, std::size_t digits) {
    unsigned value = 0;
    if (text.empty() || text.size() > digits) return std::nullopt;
    const auto [end, failed] = std::from_chars(text.data(), text.data() + text.size(), value, base);
    if (failed != std::errc() || end != text.data() + text.size()) return std::nullopt;
    return value;
}

std::vector<std::string_view> split(std::string_view text, char separator) {
    std::vector<std::string_view> parts;
    while (true) {
        const std::size_t at = text.find(separator);
        parts.push_back(text.substr(0, at));
        if (at == text.npos) return parts;
        text.remove_prefix(at + 1);
    }
}

using ByteList = std::vector<std::uint8_t>;

std::optional<ByteList> dotted(std::string_view text) {
    const auto parts = split(text, '.');
    ByteList bytes;
    for (const auto part : parts) {
        const auto value = number(part, 10, 3);
        if (parts.size() != 4 || !value || *value > 255) return std::nullopt;
        bytes.push_back(static_cast<std::uint8_t>(*value));
    }
    return bytes;
}

/// The groups on one side of "::"; the last may be a dotted address.
std::optional<ByteList> groups(std::string_view text) {
    ByteList bytes;
    if (text.empty()) return bytes;
    const auto parts = split(text, ':');
    if (parts.size() > 8) return std::nullopt;
    for (std::size_t i = 0; i < parts.size(); ++i) {
        if (i + 1 == parts.size() && parts[i].find('.') != std::string_view::npos) {
            const auto tail = dotted(parts[i]);
            if (!tail) return std::nullopt;
            bytes.insert(bytes.end(), tail->begin(), tail->end());
            continue;
        }
        const auto value = number(parts[i], 16, 4);
        if (!value) return std::nullopt;
        bytes.push_back(static_cast<std::uint8_t>(*value >> 8));
        bytes.push_back(static_cast<std::uint8_t>(*value & 0xFF));
    }
    return bytes;
}

std::optional<ByteList> coloned(std::string_view text) {
    const std::size_t gap = text.find("::");
    if (gap == text.npos) {
        auto all = groups(text);
        return all && all->size() == 16 ? all : std::nullopt;
    }
    auto head = groups(text.substr(0, gap));
    const auto tail = groups(text.substr(gap + 2));
    if (!head || !tail || head->size() + tail->size() > 14) return std::nullopt;
    head->resize(16 - tail->size());
    head->insert(head->end(), tail->begin(), tail->end());
    return head;
}

/// Start and length of the longest run of two or more zero groups, the first of equals; past the end where there
/// is none.
std::pair<std::size_t, std::size_t> longestGap(const std::array<unsigned, 8>& parts) {
    std::size_t start = parts.size(), longest = 1;
    for (std::size_t i = 0; i < parts.size(); ++i) {
        std::size_t length = 0;
        while (i + length < parts.size() && parts[i + length] == 0) ++length;
        if (length > longest) start = i, longest = length;
        i += length;
    }
    return {start, longest};
}

std::string hexadecimal(unsigned value) {
    char digits[8];
    const auto end = std::to_chars(digits, digits + sizeof digits, value, 16).ptr;
    return {digits, end};
}

std::string colonText(Bytes bytes) {
    std::array<unsigned, 8> parts{};
    for (std::size_t i = 0; i < 8; ++i) parts[i] = bytes[2 * i] << 8U | bytes[2 * i + 1];
    const auto [start, length] = longestGap(parts);
    std::string text;
    for (std::size_t i = 0; i < parts.size(); ++i) {
        if (i == start) {
            text += "::";
            i += length - 1;
            continue;
        }
        if (!text.empty() && text.back() != ':') text += ':';
        text += hexadecimal(parts[i]);
    }
    return text;
}

}  // namespace

std::optional<IPAddress> IPAddress::fromText(std::string_view text) {
    text = text.substr(0, text.find('%'));
    const auto bytes = text.find(':') == text.npos ? dotted(text) : coloned(text);
    return bytes ? fromBytes(*bytes) : std::nullopt;
}

std::optional<IPAddress> IPAddress::fromBytes(Bytes bytes) {
    if (bytes.size() == 16 && startsWith(bytes, {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0xFF, 0xFF}, 96))
        bytes = bytes.subspan(12);
    if (bytes.size() != 4 && bytes.size() != 16) return std::nullopt;
    IPAddress address;
    address.size_ = static_cast<std::uint8_t>(bytes.size());
    std::copy(bytes.begin(), bytes.end(), address.bytes_.begin());
    return address;
}

std::string IPAddress::text() const {
    if (!isIPv4()) return colonText(bytes());
    std::string text;
    for (std::size_t i = 0; i < 4; ++i) text += (i ? "." : "") + std::to_string(bytes_[i]);
    return text;
}

bool IPAddress::unspecified() const {
    return std::all_of(bytes_.begin(), bytes_.end(), [](std::uint8_t byte) { return byte == 0; });
}

bool IPAddress::loopback() const {
    if (isIPv4()) return bytes_[0] == 127;
    return startsWith(bytes(), {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 1}, 128);
}

bool IPAddress::linkLocal() const {
    return isIPv4() ? startsWith(bytes(), {169, 254}, 16) : startsWith(bytes(), {0xFE, 0x80}, 10);
}

bool IPAddress::privateUse() const {
    if (!isIPv4()) return startsWith(bytes(), {0xFC}, 7);
    return startsWith(bytes(), {10}, 8) || startsWith(bytes(), {172, 16}, 12) ||
           startsWith(bytes(), {192, 168}, 16);
}

bool IPAddress::sharedUse() const {
    return isIPv4() && startsWith(bytes(), {100, 64}, 10);
}

bool IPAddress::multicast() const {
    return isIPv4() ? startsWith(bytes(), {224}, 4) : startsWith(bytes(), {0xFF}, 8);
}

bool IPAddress::global() const {
    return !unspecified() && !loopback() && !linkLocal() && !privateUse() && !sharedUse() && !multicast();
}

bool IPAddress::sharesPrefix(const IPAddress& other, unsigned length) const {
    if (size_ != other.size_ || length > size_ * 8U) return false;
    for (unsigned bit = 0; bit < length; bit += 8) {
        const unsigned left = std::min(8U, length - bit);
        if (((bytes_[bit / 8] ^ other.bytes_[bit / 8]) >> (8 - left)) != 0) return false;
    }
    return true;
}

bool contains(const std::vector<IPAddress>& list, const IPAddress& address) {
    return std::find(list.begin(), list.end(), address) != list.end();
}

void add(std::vector<IPAddress>& list, const std::vector<IPAddress>& more) {
    for (const IPAddress& each : more)
        if (!contains(list, each)) list.push_back(each);
}

std::vector<IPAddress> without(std::vector<IPAddress> list, const std::vector<IPAddress>& others) {
    std::erase_if(list, [&](const IPAddress& each) { return contains(others, each); });
    return list;
}

}  // namespace wp
