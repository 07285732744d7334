#include "linux/reverse_path_filter.h"

#include <net/if.h>

#include <algorithm>
#include <array>
#include <cstdlib>

#include "linux/files/key_value_file.h"
#include "linux/probe/ip_socket.h"
#include "linux/route_query.h"

namespace wp {
namespace {

/// 1 is strict, 2 loose; of those for all interfaces and for one the greater counts.
constexpr int kStrict = 1;

int filterOf(const std::string& interfaceName) {
    const auto text = readSmallFile("/proc/sys/net/ipv4/conf/" + interfaceName + "/rp_filter", 64);
    return text ? std::atoi(text->c_str()) : 0;
}

/// The interface's name; its number where it has just gone.
std::string nameOf(std::uint32_t interfaceIndex) {
    std::array<char, IF_NAMESIZE> name{};
    const bool isThere = ::if_indextoname(interfaceIndex, name.data()) != nullptr;
    return isThere ? name.data() : "interface " + std::to_string(interfaceIndex);
}

}  // namespace

std::optional<Error> droppedByFilter(const Link& link, const std::vector<IPAddress>& senders,
                                     const Until& until) {
    const int ofAll = filterOf("all");
    if (std::max(ofAll, filterOf(link.interfaceName)) != kStrict) return std::nullopt;
    for (const IPAddress& each : senders) {
        const auto own = each.isIPv4() ? sourceToward(each, link.interfaceName) : std::nullopt;
        if (!own) continue;
        const auto back = routeFor({each, 0, own}, until);
        if (!back || !*back || (*back)->hops.empty() || (*back)->over(link.interfaceIndex) != nullptr)
            continue;
        return failure(Reason::badConfiguration,
                       "this device drops what comes over " + link.interfaceName + " from " + each.text() +
                           ", since its way there is " + nameOf((*back)->hops.front().interfaceIndex) +
                           " (strict reverse path filter, net.ipv4.conf." +
                           (ofAll == kStrict ? "all" : link.interfaceName) + ".rp_filter)");
    }
    return std::nullopt;
}

}  // namespace wp
