#include "linux/files/networkd.h"

#include <strings.h>

#include <algorithm>
#include <filesystem>

#include "linux/files/address_list.h"
#include "linux/files/folder.h"
#include "linux/files/leases.h"
#include "linux/files/octets.h"
#include "linux/files/processes.h"
#include "service/plain_text.h"

namespace wp {
namespace {

std::vector<std::string> valuesOf(const UnitFile& settings, const std::string& section,
                                  const std::string& key) {
    const auto found = settings.find(section);
    if (found == settings.end()) return {};
    const auto values = found->second.find(key);
    return values == found->second.end() ? std::vector<std::string>() : values->second;
}

std::string lastOf(const UnitFile& settings, const std::string& key, const std::string& otherwise) {
    const auto values = valuesOf(settings, "Network", key);
    return values.empty() ? otherwise : values.back();
}

bool isYes(const std::string& value) {
    constexpr const char* kYes[] = {"yes", "y", "true", "t", "1", "on"};
    return std::ranges::any_of(kYes,
                               [&](const char* each) { return ::strcasecmp(each, value.c_str()) == 0; });
}

/// Whether an address of the family stands in the settings.
bool hasAddress(const UnitFile& settings, bool ipv4) {
    for (const char* section : {"Network", "Address"})
        for (const std::string& value : valuesOf(settings, section, "Address")) {
            const auto address = IPAddress::fromText(value.substr(0, value.find('/')));
            if (address && address->isIPv4() == ipv4 && !address->linkLocal()) return true;
        }
    return false;
}

void addServers(const std::string& words, std::vector<IPAddress>& servers) {
    for (const std::string& word : wordsOf(words))
        if (const auto address = serverFrom(word)) add(servers, {*address});
}

/// A file's settings, and then those of the files that add to it: of all its folders in the order of their names, each name from
/// the first folder that has it.
UnitFile readSettings(const std::string& file, const std::string& root) {
    constexpr const char* kFolders[] = {"/etc", "/run", "/usr/local/lib", "/usr/lib", "/lib"};
    std::map<std::string, std::string> more;
    for (const char* each : kFolders) {
        const std::string folder =
            root + each + "/systemd/network/" + std::filesystem::path(file).filename().string() + ".d";
        for (const std::string& name : namesIn(folder))
            if (name.ends_with(".conf")) more.emplace(name, folder + "/" + name);
    }
    UnitFile settings;
    if (const auto text = readSmallFile(root + file)) readUnitFile(*text, settings);
    for (const auto& [name, path] : more)
        if (const auto text = readSmallFile(path)) readUnitFile(*text, settings);
    return settings;
}

/// Whether it was told not to manage the interface, or manages it no more.
bool isLeftAlone(const std::map<std::string, std::string>& state) {
    const auto how = state.find("ADMIN_STATE");
    return how != state.end() && (how->second == "unmanaged" || how->second == "linger");
}

void addLease(const std::map<std::string, std::string>& lease, NetworkdLink& link) {
    const auto value = [&lease](const char* key) {
        const auto found = lease.find(key);
        return found == lease.end() ? std::string() : found->second;
    };
    link.hasLease = !value("ADDRESS").empty();
    addServers(value("DNS"), link.offeredServers);
    link.portalApi = portalUriFrom(value("CAPTIVE_PORTAL"));
    link.vendorText = plainText(octetsFrom(value("VENDOR_SPECIFIC")).value_or(""));
}

}  // namespace

AddressMethods methodsFromNetworkd(const UnitFile& settings) {
    AddressMethods methods;
    const std::string dhcp = lastOf(settings, "DHCP", "no");
    const std::string local = lastOf(settings, "LinkLocalAddressing", "ipv6");
    const bool both = isYes(dhcp) || dhcp == "both";
    const bool local4 = isYes(local) || local == "ipv4", local6 = isYes(local) || local == "ipv6";
    methods.ipv4 = std::string(both || dhcp == "ipv4" || dhcp == "v4" ? "auto"
                               : hasAddress(settings, true)           ? "manual"
                               : local4                               ? "link-local"
                                                                      : "disabled");
    const bool advertised = isYes(lastOf(settings, "IPv6AcceptRA", local6 ? "yes" : "no"));
    const bool manual6 = hasAddress(settings, false);
    methods.ipv6 = std::string(both || dhcp == "ipv6" || dhcp == "v6" || (advertised && !manual6) ? "auto"
                               : manual6                                                          ? "manual"
                               : local6 ? "link-local"
                                        : "disabled");
    return methods;
}

std::optional<NetworkdLink> readNetworkdLink(unsigned interfaceIndex, const std::string& root) {
    const std::string number = std::to_string(interfaceIndex);
    const auto text = readSmallFile(root + "/run/systemd/netif/links/" + number);
    // One that was killed leaves its state behind.
    if (!text || !mayRun("systemd-networkd", root)) return std::nullopt;
    const auto state = readAssignments(*text);
    if (state.count("NETWORK_FILE") == 0 || isLeftAlone(state)) return std::nullopt;
    const UnitFile settings = readSettings(state.at("NETWORK_FILE"), root);
    NetworkdLink link;
    link.methods = methodsFromNetworkd(settings);
    for (const std::string& words : valuesOf(settings, "Network", "DNS"))
        addServers(words, link.manualServers);
    if (const auto lease = readSmallFile(root + "/run/systemd/netif/leases/" + number))
        addLease(readAssignments(*lease), link);
    // All servers of the link. Those of IPv4 are of the lease, or a person told them at run time.
    if (const auto all = state.find("DNS"); all != state.end()) {
        std::vector<IPAddress> known;
        addServers(all->second, known);
        for (const IPAddress& each : without(known, link.manualServers))
            if (!each.isIPv4()) add(link.offeredServers, {each});
        link.advertisementsKnown = true;
    }
    // From its version 254 on: of DHCPv4, DHCPv6 or a router's advertisement.
    if (const auto portal = state.find("CAPTIVE_PORTAL"); portal != state.end())
        link.portalApi = portalUriFrom(portal->second);
    return link;
}

}  // namespace wp
