#include "linux/files/networkd.h"

#include <algorithm>

#include "linux/files/leases.h"
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
    return value == "yes" || value == "true" || value == "1" || value == "on";
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
        // A port or a name for encryption may follow.
        if (const auto address = IPAddress::fromText(word.substr(0, word.find('#'))))
            servers.push_back(*address);
}

UnitFile readSettings(const std::map<std::string, std::string>& state, const std::string& root) {
    UnitFile settings;
    std::vector<std::string> files = {state.at("NETWORK_FILE")};
    if (const auto more = state.find("NETWORK_FILE_DROPINS"); more != state.end())
        for (const std::string& each : wordsOf(more->second))
            files.push_back(
                each.substr(each.find_first_not_of('"') == each.npos ? 0 : each.find_first_not_of('"')));
    for (const std::string& file : files)
        if (const auto text = readSmallFile(root + file)) readUnitFile(*text, settings);
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
    link.vendorText = plainText(value("VENDOR_SPECIFIC"));
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
    const UnitFile settings = readSettings(state, root);
    NetworkdLink link;
    link.methods = methodsFromNetworkd(settings);
    for (const std::string& words : valuesOf(settings, "Network", "DNS"))
        addServers(words, link.manualServers);
    if (const auto lease = readSmallFile(root + "/run/systemd/netif/leases/" + number))
        addLease(readAssignments(*lease), link);
    // From its version 254 on: of DHCPv4, DHCPv6 or a router's advertisement.
    if (const auto portal = state.find("CAPTIVE_PORTAL"); portal != state.end())
        link.portalApi = portalUriFrom(portal->second);
    return link;
}

}  // namespace wp
