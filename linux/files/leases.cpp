#include "linux/files/leases.h"

#include <charconv>
#include <chrono>

#include "linux/files/key_value_file.h"
#include "service/plain_text.h"

namespace wp {
namespace {

std::string unquoted(std::string_view text) {
    if (text.size() >= 2 && text.front() == '"' && text.back() == '"') text = text.substr(1, text.size() - 2);
    return plainText(text, 512);
}

/// "4 2026/11/20 18:30:00" in UTC; "never" and "epoch N" are the other forms.
bool hasPassed(std::string_view expiry, std::int64_t now) {
    if (expiry == "never") return false;
    int parts[6] = {}, count = 0;
    const char *at = expiry.data(), *end = at + expiry.size();
    if (expiry.starts_with("epoch ")) {
        std::int64_t seconds = 0;
        std::from_chars(at + 6, end, seconds);
        return seconds <= now;
    }
    while (at != end && *at != ' ') ++at;  // the weekday
    while (at != end && count < 6) {
        const auto read = std::from_chars(at, end, parts[count]);
        at = read.ec == std::errc() ? read.ptr : at + 1;
        if (read.ec == std::errc()) ++count;
    }
    if (count < 6) return true;
    // The leap second counts; a year has four digits.
    constexpr int kHighest[6] = {9999, 12, 31, 23, 59, 60};
    for (int i = 0; i < 6; ++i)
        if (parts[i] < 0 || parts[i] > kHighest[i]) return true;
    using namespace std::chrono;
    const year_month_day day{year(parts[0]), month(static_cast<unsigned>(parts[1])),
                             std::chrono::day(static_cast<unsigned>(parts[2]))};
    if (!day.ok()) return true;
    const std::int64_t midnight = sys_days(day).time_since_epoch().count() * std::int64_t{86'400};
    return midnight + parts[3] * 3600 + parts[4] * 60 + parts[5] <= now;
}

void addServers(std::string_view list, std::vector<IPAddress>& servers) {
    while (!list.empty()) {
        const std::size_t comma = list.find(',');
        if (const auto address = IPAddress::fromText(trimmed(list.substr(0, comma))))
            servers.push_back(*address);
        list.remove_prefix(comma == list.npos ? list.size() : comma + 1);
    }
}

/// One block of the file while it is read.
struct Block {
    Lease lease;
    std::string interfaceName;
    bool passed = false;
};

void readStatement(std::string_view line, Block& block, std::int64_t now) {
    if (line.ends_with(";")) line = trimmed(line.substr(0, line.size() - 1));
    if (line.starts_with("option ")) line = trimmed(line.substr(7));
    const std::size_t blank = line.find(' ');
    if (blank == line.npos) return;
    const std::string_view name = line.substr(0, blank), value = trimmed(line.substr(blank));
    if (name == "interface") block.interfaceName = unquoted(value);
    if (name == "expire") block.passed = hasPassed(value, now);
    if (name == "domain-name-servers") addServers(value, block.lease.servers);
    if (name == "vendor-encapsulated-options" || name == "vendor-class-identifier")
        block.lease.vendorText += unquoted(value);
    if (name == "unknown-114" || name == "default-url" || name == "captive-portal")
        block.lease.portalApi = unquoted(value);
}

}  // namespace

std::optional<Lease> readDhclientLeases(std::string_view text, std::string_view interfaceName,
                                        std::int64_t now) {
    std::optional<Lease> last;
    std::optional<Block> block;
    for (std::string_view line : linesOf(text)) {
        line = trimmed(line);
        if (line.starts_with("lease ") && line.ends_with("{")) {
            block.emplace();
        } else if (line == "}" && block) {
            if (block->interfaceName == interfaceName) {
                if (block->passed)
                    last.reset();
                else
                    last = std::move(block->lease);
            }
            block.reset();
        } else if (block) {
            readStatement(line, *block, now);
        }
    }
    return last;
}

std::optional<Lease> findLease(const std::string& interfaceName, std::int64_t now, const std::string& root) {
    for (const std::string& path :
         {"/var/lib/dhcp/dhclient." + interfaceName + ".leases", std::string("/var/lib/dhcp/dhclient.leases"),
          "/var/lib/dhclient/dhclient-" + interfaceName + ".leases",
          std::string("/var/lib/dhclient/dhclient.leases")}) {
        const auto text = readSmallFile(root + path);
        auto lease = text ? readDhclientLeases(*text, interfaceName, now) : std::nullopt;
        if (lease) return lease;
    }
    return std::nullopt;
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
