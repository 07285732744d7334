#include "linux/dbus/resolved.h"

namespace wp {
namespace {

const std::string kService = "org.freedesktop.resolve1";

}  // namespace

std::vector<IPAddress> serversFrom(const BusValue& list) {
    std::vector<IPAddress> servers;
    for (const BusValue& each : list.list()) {
        const auto& pair = each.list();  // family and address
        if (pair.size() < 2) continue;
        if (const auto address = IPAddress::fromBytes(pair[1].bytes())) servers.push_back(*address);
    }
    return servers;
}

Known<std::vector<IPAddress>> resolvedServers(Bus& bus, std::uint32_t interfaceIndex, const Until& until) {
    const BusObject manager{kService, "/org/freedesktop/resolve1"};
    const auto path = bus.call(manager, kService + ".Manager", "GetLink",
                               {static_cast<std::int32_t>(interfaceIndex)}, until);
    if (!path) return path.error();
    const auto list = bus.property({kService, path->text()}, kService + ".Link", "DNS", until);
    if (!list) return list.error();
    return serversFrom(*list);
}

}  // namespace wp
