#include "linux/asked_servers.h"

#include <algorithm>

#include "linux/dbus/resolved.h"
#include "linux/files/key_value_file.h"
#include "linux/files/leases.h"

namespace wp {
namespace {

bool areHidden(const Servers& servers) {
    return std::ranges::any_of(servers, [](const IPAddress& each) { return each.loopback(); });
}

}  // namespace

void add(Servers& servers, const Servers& more) {
    for (const IPAddress& each : more)
        if (std::ranges::find(servers, each) == servers.end()) servers.push_back(each);
}

Servers effectiveServers(Known<Bus>& bus, const Link& link, const Servers& ofManager, const Until& until) {
    const auto file = readSmallFile("/etc/resolv.conf");
    Servers servers = file ? serversFromResolverFile(*file) : Servers();
    if (!areHidden(servers) || !bus) return servers;
    const auto asked = resolvedServers(*bus, link.interfaceIndex, until);
    if (!asked && ofManager.empty()) return servers;
    std::erase_if(servers, [](const IPAddress& each) { return each.loopback(); });
    add(servers, asked ? *asked : ofManager);
    return servers;
}

}  // namespace wp
