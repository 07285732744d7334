#include "linux/asked_servers.h"

#include <algorithm>
#include <filesystem>

#include "linux/dbus/resolved.h"
#include "linux/files/dnsmasq.h"
#include "linux/files/key_value_file.h"
#include "linux/files/leases.h"
#include "linux/route_query.h"

namespace wp {
namespace {

/// Whether the resolver's file is one of systemd-resolved's own: with its stub alone, or with the servers of all links.
bool isResolvedsFile() {
    std::error_code error;
    const std::string file = std::filesystem::canonical("/etc/resolv.conf", error).string();
    return !error && (file.starts_with("/run/systemd/resolve/") || file == "/usr/lib/systemd/resolv.conf");
}

/// systemd-resolved answers at addresses of its own; any other resolver is looked for in its place.
bool isResolveds(const IPAddress& server) {
    return server.text() == "127.0.0.53" || server.text() == "127.0.0.54";
}

Known<ResolvedServers> askResolved(Known<Bus>& bus, const Link& link, const Until& until) {
    return bus ? resolvedServers(*bus, link.interfaceIndex, until) : bus.error();
}

AskedServers united(const ResolvedServers& resolved) {
    AskedServers asked{resolved.ofLink, resolved.ofDevice, true};
    add(asked.all, resolved.ofDevice);
    return asked;
}

/// Whom the resolver on the device asks; none where it does not tell.
AskedServers behindResolver(Known<Bus>& bus, const Link& link, const Servers& named, const Servers& ofManager,
                            const Until& until) {
    if (std::ranges::none_of(named, isResolveds))
        if (auto found = dnsmasqServers()) {
            if (found->heedsBus) add(found->asked, ofManager);
            return {std::move(found->asked), std::move(found->entered)};
        }
    const auto resolved = askResolved(bus, link, until);
    if (!resolved) return {ofManager, {}};
    // Where the file is not its own it takes what stands there for entered.
    if (std::ranges::none_of(named, isResolveds))
        return {resolved->ofLink.empty() ? ofManager : resolved->ofLink, {}};
    return united(*resolved);
}

/// Whether a route over another interface leads there that is for fewer addresses than any over this one. A default route
/// is no such route, be it in two halves; a cable may have the preferred one.
bool isElsewhere(const IPAddress& server, const Link& link, const Until& until) {
    constexpr unsigned kHalf = 1;
    if (server.loopback() || server.linkLocal()) return false;
    const auto best = routeFor({server}, until);
    if (!best || !*best || (*best)->over(link.interfaceIndex) != nullptr || (*best)->prefixLength <= kHalf)
        return false;
    const auto own = routeOver(link, server, until);
    return own && (!*own || (*own)->prefixLength < (*best)->prefixLength);
}

AskedServers serversInUse(Known<Bus>& bus, const Link& link, const Servers& ofManager, const Until& until) {
    const auto file = readSmallFile("/etc/resolv.conf");
    AskedServers asked{file ? serversFromResolverFile(*file) : Servers(), {}};
    if (isResolvedsFile())
        if (const auto resolved = askResolved(bus, link, until))
            if (AskedServers own = united(*resolved); !own.all.empty()) return own;
    if (!std::ranges::any_of(asked.all, &IPAddress::loopback)) return asked;
    AskedServers behind = behindResolver(bus, link, asked.all, ofManager, until);
    if (behind.all.empty()) return {std::move(asked.all), std::move(behind.entered)};
    std::erase_if(asked.all, [](const IPAddress& each) { return each.loopback(); });
    behind.ofLinkAlone &= asked.all.empty();
    add(asked.all, behind.all);
    behind.all = std::move(asked.all);
    return behind;
}

}  // namespace

AskedServers askedServers(Known<Bus>& bus, const Link& link, const Servers& ofManager, const Until& until) {
    AskedServers asked = serversInUse(bus, link, ofManager, until);
    if (asked.ofLinkAlone) return asked;
    for (const IPAddress& each : asked.all)
        if (!contains(ofManager, each) && isElsewhere(each, link, until)) asked.elsewhere.push_back(each);
    return asked;
}

}  // namespace wp
