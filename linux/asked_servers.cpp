#include "linux/asked_servers.h"

#include <algorithm>

#include "linux/dbus/resolved.h"
#include "linux/files/dnsmasq.h"
#include "linux/files/key_value_file.h"
#include "linux/files/leases.h"

namespace wp {
namespace {

/// systemd-resolved answers at addresses of its own; any other resolver is looked for in its place.
bool isResolveds(const IPAddress& server) {
    return server.text() == "127.0.0.53" || server.text() == "127.0.0.54";
}

/// Whom the resolver on the device asks; none where it does not tell.
AskedServers behindResolver(Known<Bus>& bus, const Link& link, const Servers& named, const Servers& ofManager,
                            const Until& until) {
    if (std::ranges::none_of(named, isResolveds))
        if (auto found = dnsmasqServers()) {
            if (found->heedsBus) add(found->asked, ofManager);
            return {std::move(found->asked), std::move(found->entered)};
        }
    const auto resolved = bus ? resolvedServers(*bus, link.interfaceIndex, until) : bus.error();
    return {resolved ? *resolved : ofManager, {}};
}

}  // namespace

void add(Servers& servers, const Servers& more) {
    for (const IPAddress& each : more)
        if (std::ranges::find(servers, each) == servers.end()) servers.push_back(each);
}

AskedServers askedServers(Known<Bus>& bus, const Link& link, const Servers& ofManager, const Until& until) {
    const auto file = readSmallFile("/etc/resolv.conf");
    AskedServers asked{file ? serversFromResolverFile(*file) : Servers(), {}};
    if (!std::ranges::any_of(asked.all, &IPAddress::loopback)) return asked;
    AskedServers behind = behindResolver(bus, link, asked.all, ofManager, until);
    if (behind.all.empty()) return asked;
    std::erase_if(asked.all, [](const IPAddress& each) { return each.loopback(); });
    add(asked.all, behind.all);
    asked.entered = std::move(behind.entered);
    return asked;
}

}  // namespace wp
