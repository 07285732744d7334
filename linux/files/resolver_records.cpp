#include "linux/files/resolver_records.h"

#include <algorithm>
#include <filesystem>

#include "linux/files/folder.h"
#include "linux/files/key_value_file.h"
#include "linux/files/leases.h"

namespace wp {
namespace {

using Servers = std::vector<IPAddress>;

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
    const bool isIPv4 =
        isOneOf(source, {"dhclient", "udhcpc", "dhcpcd", "pump", "dhcp"}) || (isOpen && source.empty());
    if (source == "inet" || (source == "inet6" && !isOpen)) add(records.entered, servers);
    if (isIPv4 || isOneOf(source, {"ra", "dhcp6", "ip6.dhclient", "ip6.dhcpcd", "ip6.udhcpc"}))
        add(records.offered, servers);
    records.offerKnown |= isIPv4;
}

}  // namespace

ResolverRecords resolverRecords(const std::string& interfaceName, const std::string& root) {
    ResolverRecords records;
    Servers others, own;
    for (const bool isOpen : {false, true}) {
        const std::string folder =
            root + (isOpen ? "/run/resolvconf/interfaces" : "/run/resolvconf/interface");
        for (const std::string& name : namesIn(folder)) {
            const auto text = readSmallFile(folder + "/" + name);
            if (!text) continue;
            const Servers servers = serversFromResolverFile(*text);
            const bool isOwn = name == interfaceName || name.starts_with(interfaceName + ".");
            // Other records are those of programs, as of what the file held before.
            if (!isOwn && !isInterface(name.substr(0, name.find('.')), root)) continue;
            add(isOwn ? own : others, servers);
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
