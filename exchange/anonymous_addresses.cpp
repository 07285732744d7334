#include "exchange/anonymous_addresses.h"

#include <arpa/inet.h>

#include <algorithm>
#include <array>
#include <cstdio>

namespace wp {
namespace {

bool isHex(char c) {
    return (c >= '0' && c <= '9') || (c >= 'a' && c <= 'f') || (c >= 'A' && c <= 'F');
}

bool isWordByte(unsigned char c) {
    return (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c >= 0x80;
}

bool isWordByteAt(std::string_view text, std::size_t i) {
    return i < text.size() && isWordByte(static_cast<unsigned char>(text[i]));
}

/// The forms of a hardware address; a digit of it stands for each 'h'.
constexpr std::array<std::string_view, 4> kHardwareForms{"hh:hh:hh:hh:hh:hh", "hh-hh-hh-hh-hh-hh",
                                                         "hhhh.hhhh.hhhh", "hhhhhhhhhhhh"};

bool hasForm(std::string_view word, std::string_view form) {
    for (std::size_t i = 0; i < form.size(); ++i)
        if (i >= word.size() || (form[i] == 'h' ? !isHex(word[i]) : word[i] != form[i])) return false;
    return true;
}

/// The form in which the text begins; empty without one.
std::string_view hardwareForm(std::string_view text) {
    for (std::string_view form : kHardwareForms)
        if (hasForm(text, form)) return form;
    return {};
}

/// The hexadecimal digits of the word, in lower case.
std::string hardwareDigits(std::string_view word) {
    std::string digits;
    for (char c : word)
        if (isHex(c)) digits += c >= 'A' && c <= 'F' ? static_cast<char>(c - 'A' + 'a') : c;
    return digits;
}

/// Whether the separator stands here with one more number of a row behind it.
bool numberFollows(std::string_view text, std::size_t end, char separator, std::size_t mostDigits) {
    if (end >= text.size() || text[end] != separator) return false;
    std::size_t last = end + 1;
    while (last < text.size() && isHex(text[last])) ++last;
    std::size_t digits = last - end - 1;
    return digits > 0 && digits <= mostDigits && !isWordByteAt(text, last);
}

/// Whether one more number of a row stands before, with the separator behind it; the first may be a version's, "v1".
bool numberPrecedes(std::string_view text, std::size_t begin, char separator, std::size_t mostDigits) {
    if (begin == 0 || text[begin - 1] != separator) return false;
    std::size_t first = begin - 1;
    while (first > 0 && isHex(text[first - 1])) --first;
    std::size_t digits = begin - 1 - first;
    if (first > 0 && (text[first - 1] == 'v' || text[first - 1] == 'V')) --first;
    return digits > 0 && digits <= mostDigits && (first == 0 || !isWordByteAt(text, first - 1));
}

bool isInRow(std::string_view text, std::size_t begin, std::size_t end, char separator,
             std::size_t mostDigits) {
    return numberPrecedes(text, begin, separator, mostDigits) ||
           numberFollows(text, end, separator, mostDigits);
}

/// The number of the key, counted from 1 in the order of first use.
std::uint32_t numberOf(std::map<std::string, std::uint32_t>& numbers, const std::string& key) {
    return numbers.try_emplace(key, static_cast<std::uint32_t>(numbers.size() + 1)).first->second;
}

/// A locally administered address in that form.
std::string locallyAdministered(std::uint32_t number, std::string_view form) {
    std::array<char, 16> digits{};
    std::snprintf(digits.data(), digits.size(), "0200%08x", number);
    std::string text;
    for (std::size_t next = 0; char c : form) text += c == 'h' ? digits[next++] : c;
    return text;
}

/// Addresses that belong to nobody: private, shared, loopback, link-local, multicast, reserved, any.
bool isNobodys(std::uint32_t address) {
    struct Range {
        std::uint32_t base;
        int bits;
    };
    constexpr std::array<Range, 9> ranges{{{0x00000000, 8},
                                           {0x0A000000, 8},
                                           {0x64400000, 10},
                                           {0x7F000000, 8},
                                           {0xA9FE0000, 16},
                                           {0xAC100000, 12},
                                           {0xC0A80000, 16},
                                           {0xC6120000, 15},
                                           {0xE0000000, 3}}};
    for (const Range& range : ranges)
        if ((address ^ range.base) >> (32 - range.bits) == 0) return true;
    return false;
}

}  // namespace

std::string AnonymousAddresses::hardwareAddress(const std::string& address) {
    std::string_view form = hardwareForm(address);
    bool isPlain = !form.empty() && form.size() == address.size();
    std::string digits = isPlain ? hardwareDigits(address) : address;
    if (digits == "000000000000" || digits == "ffffffffffff" || address.empty()) return address;
    return locallyAdministered(numberOf(hardware_, digits), isPlain ? form : kHardwareForms[0]);
}

std::string AnonymousAddresses::ipv4(const std::string& word) {
    in_addr address{};
    if (::inet_pton(AF_INET, word.c_str(), &address) != 1) return word;
    if (isNobodys(ntohl(address.s_addr))) return word;
    std::uint32_t number = numberOf(ipv4_, word) & 0x1FFFF;
    std::uint32_t host = 0xC6120000 | number;
    return "198." + std::to_string(host >> 16 & 0xFF) + '.' + std::to_string(host >> 8 & 0xFF) + '.' +
           std::to_string(host & 0xFF);
}

std::string AnonymousAddresses::ipv6(const std::string& word) {
    in6_addr address{};
    if (::inet_pton(AF_INET6, word.c_str(), &address) != 1) return word;
    const auto* bytes = static_cast<const std::uint8_t*>(address.s6_addr);
    if (IN6_IS_ADDR_UNSPECIFIED(&address) || IN6_IS_ADDR_LOOPBACK(&address) || bytes[0] == 0xFF) return word;
    std::string key(bytes, bytes + 16);
    const char* prefix = "2001:db8::";
    if (IN6_IS_ADDR_LINKLOCAL(&address)) prefix = "fe80::";
    if ((bytes[0] & 0xFE) == 0xFC) prefix = "fd00::";
    std::array<char, 40> text{};
    std::uint32_t number = numberOf(ipv6_, key);
    std::snprintf(text.data(), text.size(), "%s%x", prefix, number & 0xFFFF);
    return text.data();
}

/// An address that stands by itself, or behind the letters with which interfaces begin that are named after it.
AnonymousAddresses::Found AnonymousAddresses::hardwareAt(std::string_view text, std::size_t begin) {
    std::string_view rest = text.substr(begin);
    std::string prefix;
    for (std::string_view kind : {"wlx", "enx", "wwx"})
        if (rest.starts_with(kind)) prefix = kind;
    rest.remove_prefix(prefix.size());
    std::string_view form = prefix.empty() ? hardwareForm(rest) : kHardwareForms.back();
    if (form.empty() || !hasForm(rest, form)) return {};
    std::size_t end = begin + prefix.size() + form.size();
    std::size_t digits = form.find_first_not_of('h');
    bool isSplit = digits != std::string_view::npos;
    if (isWordByteAt(text, end) || (isSplit && isInRow(text, begin, end, form[digits], digits))) return {};
    return {end - begin, prefix + hardwareAddress(std::string(rest.substr(0, form.size())))};
}

/// The longest IP address that begins here and does not go on behind.
AnonymousAddresses::Found AnonymousAddresses::internetAt(std::string_view text, std::size_t begin) {
    std::size_t end = begin;
    std::size_t longest = std::min<std::size_t>(text.size(), begin + INET6_ADDRSTRLEN);
    while (end < longest && (isHex(text[end]) || text[end] == ':' || text[end] == '.')) ++end;
    for (; end > begin; --end) {
        if (isWordByteAt(text, end) || isInRow(text, begin, end, '.', 3)) continue;
        std::string word(text.substr(begin, end - begin));
        in6_addr address{};
        if (::inet_pton(AF_INET, word.c_str(), &address) == 1) return {word.size(), ipv4(word)};
        if (isInRow(text, begin, end, ':', 4)) continue;
        if (::inet_pton(AF_INET6, word.c_str(), &address) == 1) return {word.size(), ipv6(word)};
    }
    return {};
}

AnonymousAddresses::Found AnonymousAddresses::addressAt(std::string_view text, std::size_t begin) {
    if (begin > 0 && isWordByteAt(text, begin - 1)) return {};
    Found found = hardwareAt(text, begin);
    return found.length > 0 ? found : internetAt(text, begin);
}

std::string AnonymousAddresses::replacedWithin(std::string_view text) {
    std::string out;
    for (std::size_t i = 0; i < text.size();) {
        Found found = addressAt(text, i);
        out += found.length > 0 ? found.replacement : std::string(1, text[i]);
        i += std::max<std::size_t>(found.length, 1);
    }
    return out;
}

}  // namespace wp
