#include "linux/files/resolver_records.h"

#include <algorithm>
#include <filesystem>

#include "linux/files/key_value_file.h"
#include "linux/files/leases.h"

namespace wp {
namespace {

using Servers = std::vector<IPAddress>;

constexpr std::size_t kMostFiles = 256;

bool isOneOf(const std::string& word, std::initializer_list<const char*> words) {
    return std::ranges::find(words, word) != words.end();
}

bool isInterface(const std::string& name, const std::string& root) {
    std::error_code failed;
    return std::filesystem::exists(root + "/sys/class/net/" + name, failed);
}

/// \param source the part of a record's name behind the interface's: "dhclient", "ip6.dhclient", "inet"
/// \param isOpen whether openresolv keeps it: there "inet6" may be a lease too, and a DHCP client's has no such part
void addRecord(const std::string& source, bool isOpen, const Servers& servers, ResolverRecords& records) {
    const auto addTo = [&](Servers& list) { list.insert(list.end(), servers.begin(), servers.end()); };
    const bool isIPv4 =
        isOneOf(source, {"dhclient", "udhcpc", "dhcpcd", "pump", "dhcp"}) || (isOpen && source.empty());
    if (source == "inet" || (source == "inet6" && !isOpen)) addTo(records.entered);
    if (isIPv4 || isOneOf(source, {"ra", "dhcp6", "ip6.dhclient", "ip6.dhcpcd", "ip6.udhcpc"}))
        addTo(records.offered);
    records.offerKnown |= isIPv4;
}

}  // namespace

ResolverRecords resolverRecords(const std::string& interfaceName, const std::string& root) {
    ResolverRecords records;
    Servers others, own;
    for (const bool isOpen : {false, true}) {
        const std::string folder =
            root + (isOpen ? "/run/resolvconf/interfaces" : "/run/resolvconf/interface");
        std::error_code failed;
        std::size_t count = 0;
        for (std::filesystem::directory_iterator each(folder, failed), end;
             !failed && each != end && ++count < kMostFiles; each.increment(failed)) {
            const std::string name = each->path().filename();
            const auto text = readSmallFile(each->path());
            if (!text) continue;
            const Servers servers = serversFromResolverFile(*text);
            const bool isOwn = name == interfaceName || name.starts_with(interfaceName + ".");
            // Other records are those of programs, as of what the file held before.
            if (!isOwn && !isInterface(name.substr(0, name.find('.')), root)) continue;
            Servers& list = isOwn ? own : others;
            list.insert(list.end(), servers.begin(), servers.end());
            if (isOwn)
                addRecord(name == interfaceName ? "" : name.substr(interfaceName.size() + 1), isOpen, servers,
                          records);
        }
    }
    for (const IPAddress& each : others)
        if (!each.loopback() && !contains(own, each)) records.elsewhere.push_back(each);
    return records;
}

}  // namespace wp
