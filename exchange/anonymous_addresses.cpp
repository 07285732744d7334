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

bool isAddressByte(char c) {
    return isHex(c) || c == ':' || c == '.' || c == '-';
}

bool isWordByte(unsigned char c) {
    return (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == '_' ||
           c >= 0x80;
}

/// Six pairs of hexadecimal digits with one kind of separator; the digits in lower case, else empty.
std::string hardwareDigits(std::string_view word) {
    std::string digits;
    if (word.size() != 17 || (word[2] != ':' && word[2] != '-')) return {};
    for (std::size_t i = 0; i < word.size(); ++i) {
        bool isSeparator = i % 3 == 2;
        if (isSeparator ? word[i] != word[2] : !isHex(word[i])) return {};
        char c = word[i];
        if (!isSeparator) digits += c >= 'A' && c <= 'F' ? static_cast<char>(c - 'A' + 'a') : c;
    }
    return digits;
}

constexpr std::size_t kInterfacePrefix = 3;

/// The name of an interface after its hardware address, as the system calls adapters without a fixed place, where
/// the text begins with one; else empty.
std::string_view addressedInterface(std::string_view text) {
    std::string_view name = text.substr(0, kInterfacePrefix + 12);
    bool isKind = name.starts_with("wlx") || name.starts_with("enx") || name.starts_with("wwx");
    if (!isKind || name.size() < kInterfacePrefix + 12) return {};
    if (!std::ranges::all_of(name.substr(kInterfacePrefix), isHex)) return {};
    bool goesOn = text.size() > name.size() && isWordByte(static_cast<unsigned char>(text[name.size()]));
    return goesOn ? std::string_view() : name;
}

/// The number of the key, counted from 1 in the order of first use.
std::uint32_t numberOf(std::map<std::string, std::uint32_t>& numbers, const std::string& key) {
    return numbers.try_emplace(key, static_cast<std::uint32_t>(numbers.size() + 1)).first->second;
}

std::string locallyAdministered(std::uint32_t number, char separator) {
    std::array<char, 24> text{};
    std::snprintf(text.data(), text.size(), "02%c00%c%02x%c%02x%c%02x%c%02x", separator, separator,
                  number >> 24 & 0xFF, separator, number >> 16 & 0xFF, separator, number >> 8 & 0xFF,
                  separator, number & 0xFF);
    return text.data();
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
    std::string digits = hardwareDigits(address);
    if (digits == "000000000000" || digits == "ffffffffffff" || address.empty()) return address;
    return locallyAdministered(numberOf(hardware_, digits.empty() ? address : digits),
                               digits.empty() ? ':' : address[2]);
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

std::string AnonymousAddresses::interfaceName(std::string_view name) {
    std::string address;
    for (std::size_t i = kInterfacePrefix; i < name.size(); i += 2)
        address += (address.empty() ? "" : ":") + std::string(name.substr(i, 2));
    std::string digits = hardwareAddress(address);
    std::erase(digits, ':');
    return std::string(name.substr(0, kInterfacePrefix)) + digits;
}

std::string AnonymousAddresses::replacement(const std::string& word) {
    if (!hardwareDigits(word).empty()) return hardwareAddress(word);
    std::size_t colon = word.find(':');
    bool mayHavePort = colon != std::string::npos && colon == word.rfind(':');
    if (mayHavePort) return ipv4(word.substr(0, colon)) + word.substr(colon);
    std::string other = ipv4(word);
    return other == word ? ipv6(word) : other;
}

std::string AnonymousAddresses::replacedWithin(std::string_view text) {
    std::string out;
    std::size_t i = 0;
    while (i < text.size()) {
        bool beginsWord = i == 0 || !isWordByte(static_cast<unsigned char>(text[i - 1]));
        std::string_view name = beginsWord ? addressedInterface(text.substr(i)) : std::string_view();
        if (!name.empty()) {
            out += interfaceName(name);
            i += name.size();
            continue;
        }
        std::size_t end = i;
        while (end < text.size() && isAddressByte(text[end])) ++end;
        if (end == i) {  // a word that is no address is copied as a whole, its hexadecimal letters too
            do {
                out += text[i++];
            } while (i < text.size() && isWordByte(static_cast<unsigned char>(text[i - 1])) &&
                     isWordByte(static_cast<unsigned char>(text[i])));
            continue;
        }
        std::size_t length = end - i;
        while (length > 1 && (text[i + length - 1] == '.' || text[i + length - 1] == '-' ||
                              (text[i + length - 1] == ':' && text[i + length - 2] != ':')))
            --length;  // punctuation behind it
        bool goesOn = i + length < text.size() && isWordByte(static_cast<unsigned char>(text[i + length]));
        std::string word(text.substr(i, length));
        out += goesOn ? word : replacement(word);
        i += length;
    }
    return out;
}

}  // namespace wp
