#include "linux/dbus/resolved.h"

namespace wp {
namespace {

const std::string kService = "org.freedesktop.resolve1";

void addAddress(std::vector<IPAddress>& servers, const BusValue& bytes) {
    if (const auto address = IPAddress::fromBytes(bytes.bytes())) servers.push_back(*address);
}

}  // namespace

std::vector<IPAddress> serversFrom(const BusValue& list) {
    std::vector<IPAddress> servers;
    for (const BusValue& each : list.list()) {
        const auto& pair = each.list();  // family and address
        if (pair.size() >= 2) addAddress(servers, pair[1]);
    }
    return servers;
}

std::vector<IPAddress> deviceServersFrom(const BusValue& list) {
    std::vector<IPAddress> servers;
    for (const BusValue& each : list.list()) {
        const auto& three = each.list();  // link, family and address
        if (three.size() >= 3 && three[0].number() == 0) addAddress(servers, three[2]);
    }
    return servers;
}

Known<ResolvedServers> resolvedServers(Bus& bus, std::uint32_t interfaceIndex, const Until& until) {
    const BusObject manager{kService, "/org/freedesktop/resolve1"};
    const auto path = bus.call(manager, kService + ".Manager", "GetLink",
                               {static_cast<std::int32_t>(interfaceIndex)}, until);
    if (!path) return path.error();
    const auto list = bus.property({kService, path->text()}, kService + ".Link", "DNS", until);
    if (!list) return list.error();
    const auto all = bus.property(manager, kService + ".Manager", "DNS", until);
    return ResolvedServers{serversFrom(*list), all ? deviceServersFrom(*all) : std::vector<IPAddress>()};
}

}  // namespace wp
