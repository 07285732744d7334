#include "linux/files/leases.h"

#include <algorithm>
#include <array>
#include <charconv>

#include "linux/files/address_list.h"
#include "linux/files/key_value_file.h"
#include "linux/files/octets.h"
#include "linux/utc_time.h"
#include "service/plain_text.h"

namespace wp {
namespace {

constexpr std::size_t kLongestUri = 2048, kLongestText = 512;

bool isOctal(std::string_view digits) {
    return digits.size() == 3 && digits[0] <= '3' &&
           std::ranges::all_of(digits, [](char each) { return each >= '0' && each <= '7'; });
}

/// What stands in double quotes with a backslash before quotes, backslashes and a byte's three octal digits; or, where some
/// of its bytes are no text, all of them in hexadecimal.
std::string bytesFrom(std::string_view value) {
    const bool isQuoted = value.size() >= 2 && value.front() == '"' && value.back() == '"';
    if (!isQuoted) return octetsFrom(value).value_or(std::string(value));
    value = value.substr(1, value.size() - 2);
    std::string bytes;
    for (std::size_t at = 0; at < value.size(); ++at) {
        const std::string_view digits = value.substr(at + 1, 3);
        if (value[at] != '\\' || at + 1 == value.size()) {
            bytes += value[at];
        } else if (isOctal(digits)) {
            bytes += static_cast<char>((digits[0] - '0') * 64 + (digits[1] - '0') * 8 + digits[2] - '0');
            at += 3;
        } else {
            bytes += value[++at];
        }
    }
    return bytes;
}

std::string textFrom(std::string_view value) {
    return plainText(bytesFrom(value), kLongestText);
}

/// "4 2026/11/20 18:30:00" in UTC; "never" and "epoch N" are the other forms.
bool hasPassed(std::string_view expiry, std::int64_t now) {
    if (expiry == "never") return false;
    std::array<int, 6> parts{};
    std::size_t count = 0;
    const char *at = expiry.data(), *end = at + expiry.size();
    if (expiry.starts_with("epoch ")) {
        std::int64_t seconds = 0;
        std::from_chars(at + 6, end, seconds);
        return seconds <= now;
    }
    while (at != end && *at != ' ') ++at;  // the weekday
    while (at != end && count < parts.size()) {
        const auto read = std::from_chars(at, end, parts[count]);
        at = read.ec == std::errc() ? read.ptr : at + 1;
        if (read.ec == std::errc()) ++count;
    }
    if (count < parts.size()) return true;
    const auto over = unixTime(parts);
    return !over || *over <= now;
}

bool contains(const std::vector<IPAddress>& list, const std::optional<IPAddress>& address) {
    return address && std::ranges::find(list, *address) != list.end();
}

/// One block of the file while it is read.
struct Block {
    Lease lease;
    std::string interfaceName;
    bool passed = false;
};

struct Statement {
    std::string_view name, value;
};

/// "name value;" or "option name value;"; without a value both are empty.
Statement statementIn(std::string_view line) {
    if (line.ends_with(";")) line = trimmed(line.substr(0, line.size() - 1));
    if (line.starts_with("option ")) line = trimmed(line.substr(7));
    const std::size_t blank = line.find(' ');
    if (blank == line.npos) return {};
    return {line.substr(0, blank), trimmed(line.substr(blank))};
}

void readStatement(std::string_view line, Block& block, std::int64_t now) {
    const auto [name, value] = statementIn(line);
    if (name == "interface") block.interfaceName = textFrom(value);
    if (const auto address = IPAddress::fromText(value); address && name == "fixed-address")
        block.lease.addresses = {*address};
    if (name == "expire") block.passed = hasPassed(value, now);
    if (name == "domain-name-servers") block.lease.servers = addressesIn(value);
    if (name == "vendor-encapsulated-options" || name == "vendor-class-identifier")
        block.lease.vendorText += textFrom(value);
    if (name == "default-url" || name == "unknown-114" ||
        (name == "v4-captive-portal" && block.lease.portalApi.empty()))
        block.lease.portalApi = portalUriFrom(bytesFrom(value));
}

/// An address that a lease of DHCPv6 grants; or a prefix, which is passed over.
struct Grant {
    std::optional<IPAddress> address;
    std::uint32_t starts = 0;   ///< since 1970
    std::uint32_t seconds = 0;  ///< all bits set: without an end
};

/// One block of the file of DHCPv6. It holds groups of addresses, and these an address each, in braces of their own.
struct Block6 {
    Lease lease;
    std::string interfaceName;
    std::vector<Grant> grants;
    int depth = 1;
};

constexpr int kInGrant = 3;

std::uint32_t numberIn(std::string_view text) {
    std::uint32_t number = 0;
    std::from_chars(text.data(), text.data() + text.size(), number);
    return number;
}

/// A line that opens braces.
void openBraces(std::string_view line, Block6& block) {
    if (++block.depth != kInGrant) return;
    const auto [name, value] = statementIn(line);
    block.grants.emplace_back();
    if (name == "iaaddr") block.grants.back().address = IPAddress::fromText(value.substr(0, value.find(' ')));
}

void readStatement6(std::string_view line, Block6& block) {
    const auto [name, value] = statementIn(line);
    if (block.depth == kInGrant) {
        if (name == "starts") block.grants.back().starts = numberIn(value);
        if (name == "max-life") block.grants.back().seconds = numberIn(value);
    }
    if (block.depth > 1) return;
    if (name == "interface") block.interfaceName = textFrom(value);
    if (name == "dhcp6.name-servers") block.lease.servers = addressesIn(value);
    if (name == "dhcp6.v6-captive-portal" || name == "dhcp6.unknown-103")
        block.lease.portalApi = portalUriFrom(bytesFrom(value));
}

bool isInForce(const Grant& grant, const std::vector<IPAddress>& assigned, std::int64_t now) {
    constexpr std::uint32_t kWithoutEnd = 0xFFFFFFFF;
    return contains(assigned, grant.address) &&
           (grant.seconds == kWithoutEnd || std::int64_t{grant.starts} + grant.seconds > now);
}

/// The first that can be read and holds a lease.
template <class Read>
std::optional<Lease> firstOf(const std::string& root, std::initializer_list<std::string> paths, Read read) {
    for (const std::string& path : paths) {
        const auto text = readSmallFile(root + path);
        std::optional<Lease> lease = text ? read(*text) : std::nullopt;
        if (lease) return lease;
    }
    return std::nullopt;
}

}  // namespace

std::string portalUriFrom(std::string_view text) {
    return text.size() > kLongestUri ? std::string() : plainText(text, kLongestUri);
}

std::optional<Lease> readDhclientLeases(std::string_view text, std::string_view interfaceName,
                                        const std::vector<IPAddress>& assigned, std::int64_t now) {
    std::optional<Lease> last;
    std::optional<Block> block;
    for (std::string_view line : linesOf(text)) {
        line = trimmed(line);
        if (line.starts_with("lease ") && line.ends_with("{")) {
            block.emplace();
        } else if (line == "}" && block) {
            const bool counts = !block->passed && !block->lease.addresses.empty() &&
                                contains(assigned, block->lease.addresses[0]);
            if (block->interfaceName == interfaceName)
                last = counts ? std::optional(std::move(block->lease)) : std::nullopt;
            block.reset();
        } else if (block) {
            readStatement(line, *block, now);
        }
    }
    return last;
}

std::optional<Lease> readDhclient6Leases(std::string_view text, std::string_view interfaceName,
                                         const std::vector<IPAddress>& assigned, std::int64_t now) {
    std::optional<Lease> last;
    std::optional<Block6> block;
    for (std::string_view line : linesOf(text)) {
        line = trimmed(line);
        if (!block) {
            if (line.starts_with("lease6 ") && line.ends_with("{")) block.emplace();
        } else if (line.ends_with("{")) {
            openBraces(line, *block);
        } else if (line != "}") {
            readStatement6(line, *block);
        } else if (--block->depth == 0) {
            for (const Grant& each : block->grants)
                if (isInForce(each, assigned, now)) block->lease.addresses.push_back(*each.address);
            if (block->interfaceName == interfaceName)
                last = block->lease.addresses.empty() ? std::nullopt : std::optional(std::move(block->lease));
            block.reset();
        }
    }
    return last;
}

std::optional<Lease> findLease(const std::string& interfaceName, const std::vector<IPAddress>& assigned,
                               std::int64_t now, const std::string& root) {
    return firstOf(
        root,
        {"/var/lib/dhcp/dhclient." + interfaceName + ".leases", "/var/lib/dhcp/dhclient.leases",
         "/var/lib/dhclient/dhclient-" + interfaceName + ".leases", "/var/lib/dhclient/dhclient.leases"},
        [&](const std::string& text) { return readDhclientLeases(text, interfaceName, assigned, now); });
}

std::optional<Lease> findLease6(const std::string& interfaceName, const std::vector<IPAddress>& assigned,
                                std::int64_t now, const std::string& root) {
    return firstOf(
        root,
        {"/var/lib/dhcp/dhclient6." + interfaceName + ".leases", "/var/lib/dhcp/dhclient6.leases",
         "/var/lib/dhclient/dhclient6-" + interfaceName + ".leases", "/var/lib/dhclient/dhclient6.leases"},
        [&](const std::string& text) { return readDhclient6Leases(text, interfaceName, assigned, now); });
}

std::vector<IPAddress> serversFromResolverFile(std::string_view text) {
    std::vector<IPAddress> servers;
    for (const std::string_view line : linesOf(text)) {
        const auto words = wordsOf(line);
        if (words.size() < 2 || words[0] != "nameserver") continue;
        if (const auto address = IPAddress::fromText(words[1])) servers.push_back(*address);
    }
    return servers;
}

}  // namespace wp
