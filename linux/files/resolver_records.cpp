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

/// Servers by whom they were told of; of the interface itself by who told them, too.
struct Told {
    ResolverRecords records;
    Servers own, others;
};

/// \param source the part of a record's name behind the interface's: "dhclient", "ip6.dhclient", "inet"
/// \param isOpen whether openresolv keeps it: there "inet6" may be a lease too, and a DHCP client's has no such part
void addOwn(const std::string& source, bool isOpen, const Servers& servers, Told& told) {
    ResolverRecords& records = told.records;
    const bool isIPv4 =
        isOneOf(source, {"dhclient", "udhcpc", "dhcpcd", "pump", "dhcp"}) || (isOpen && source.empty());
    if (source == "inet" || (source == "inet6" && !isOpen)) add(records.entered, servers);
    if (isIPv4 || isOneOf(source, {"ra", "dhcp6", "ip6.dhclient", "ip6.dhcpcd", "ip6.udhcpc"}))
        add(records.offered, servers);
    records.offerKnown |= isIPv4;
    add(told.own, servers);
}

void readRecords(const std::string& folder, bool isOpen, const std::string& interfaceName,
                 const std::string& root, Told& told) {
    for (const std::string& name : namesIn(folder)) {
        const auto text = readSmallFile(folder + "/" + name);
        const Servers servers = text ? serversFromResolverFile(*text) : Servers();
        if (name == interfaceName || name.starts_with(interfaceName + "."))
            addOwn(name.substr(std::min(name.size(), interfaceName.size() + 1)), isOpen, servers, told);
        // What is set of the loopback interface is set for the whole device.
        else if (isOneOf(name, {"lo.inet", "lo.inet6"}))
            add(told.records.entered, servers);
        // Other records are those of programs, as of what the file held before.
        else if (isInterface(name.substr(0, name.find('.')), root))
            add(told.others, servers);
    }
}

}  // namespace

ResolverRecords resolverRecords(const std::string& interfaceName, const std::string& root) {
    Told told;
    readRecords(root + "/run/resolvconf/interface", false, interfaceName, root, told);
    readRecords(root + "/run/resolvconf/interfaces", true, interfaceName, root, told);
    for (const IPAddress& each : without(without(told.others, told.own), told.records.entered))
        if (!each.loopback()) told.records.elsewhere.push_back(each);
    return std::move(told.records);
}

}  // namespace wp
