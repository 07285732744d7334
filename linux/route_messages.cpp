#include "linux/route_messages.h"

#include <linux/if_addr.h>
#include <linux/neighbour.h>
#include <linux/rtnetlink.h>
#include <sys/socket.h>

#include <algorithm>
#include <utility>

namespace wp {
namespace {

std::optional<Address::Family> familyOf(unsigned char family) {
    if (family == AF_INET) return Address::Family::ipv4;
    if (family == AF_INET6) return Address::Family::ipv6;
    return std::nullopt;
}

std::size_t sizeOf(Address::Family family) {
    return family == Address::Family::ipv4 ? 4 : 16;
}

std::optional<Address> addressOf(const ifaddrmsg& header, const Attributes& attributes) {
    const std::optional<Address::Family> family = familyOf(header.ifa_family);
    // On a point-to-point link IFA_ADDRESS is the other end's.
    std::optional<Bytes> bytes = attributes.find(IFA_LOCAL);
    if (!bytes) bytes = attributes.find(IFA_ADDRESS);
    if (!family || !bytes || bytes->size() != sizeOf(*family)) return std::nullopt;
    const std::uint32_t flags = attributes.number<std::uint32_t>(IFA_FLAGS).value_or(header.ifa_flags);
    // No new connection begins from an IPv6 address whose time is up (RFC 4862).
    const std::uint32_t passed = *family == Address::Family::ipv6 ? IFA_F_DEPRECATED : 0;
    return Address{*family,
                   {bytes->begin(), bytes->end()},
                   header.ifa_scope == RT_SCOPE_UNIVERSE,
                   (flags & (IFA_F_TENTATIVE | IFA_F_DADFAILED | passed)) == 0};
}

/// The router's address; one of the other family stands behind two bytes that name it.
std::optional<IPAddress> routerIn(const Attributes& attributes) {
    std::optional<Bytes> bytes = attributes.find(RTA_GATEWAY);
    if (const auto via = attributes.find(RTA_VIA); !bytes && via && via->size() > 2) bytes = via->subspan(2);
    return bytes ? IPAddress::fromBytes(*bytes) : std::nullopt;
}

/// A route with several next hops names each behind a header of its own.
std::vector<NextHop> hopsAmong(Bytes hops) {
    std::vector<NextHop> found;
    rtnexthop header;
    while (hops.size() >= sizeof header) {
        std::memcpy(&header, hops.data(), sizeof header);
        if (header.rtnh_len < sizeof header || header.rtnh_len > hops.size()) break;
        const Attributes attributes(hops.subspan(sizeof header, header.rtnh_len - sizeof header));
        found.push_back({static_cast<std::uint32_t>(header.rtnh_ifindex), routerIn(attributes)});
        hops = hops.subspan(std::min<std::size_t>((header.rtnh_len + 3U) & ~3U, hops.size()));
    }
    return found;
}

Route routeOf(const rtmsg& header, const Attributes& attributes) {
    Route route{{}, header.rtm_dst_len};
    if (const auto hops = attributes.find(RTA_MULTIPATH))
        route.hops = hopsAmong(*hops);
    else if (const auto out = attributes.number<std::uint32_t>(RTA_OIF))
        route.hops = {{*out, routerIn(attributes)}};
    return route;
}

template <class Visit>
void forEachRoute(Bytes buffer, Visit visit) {
    forEachOfType<rtmsg>(RTM_NEWROUTE, buffer, visit);
}

}  // namespace

Addresses readAddresses(Bytes buffer, std::uint32_t interfaceIndex) {
    Addresses addresses;
    forEachOfType<ifaddrmsg>(RTM_NEWADDR, buffer, [&](const ifaddrmsg& header, const Attributes& attributes) {
        if (header.ifa_index != interfaceIndex) return;
        if (const auto address = addressOf(header, attributes)) addresses.push_back(*address);
    });
    return addresses;
}

const NextHop* Route::over(std::uint32_t interfaceIndex) const {
    const auto hop = std::ranges::find(hops, interfaceIndex, &NextHop::interfaceIndex);
    return hop == hops.end() ? nullptr : &*hop;
}

std::optional<Route> readRoute(Bytes buffer) {
    std::optional<Route> first;
    bool isFirst = true;
    forEachRoute(buffer, [&](const rtmsg& header, const Attributes& attributes) {
        if (std::exchange(isFirst, false) && header.rtm_type == RTN_UNICAST)
            first = routeOf(header, attributes);
    });
    return first;
}

bool leadsElsewhere(Bytes buffer, std::uint32_t interfaceIndex) {
    bool found = false;
    forEachRoute(buffer, [&](const rtmsg& header, const Attributes& attributes) {
        if (header.rtm_dst_len != 0 || header.rtm_type != RTN_UNICAST) return;
        found |= std::ranges::any_of(routeOf(header, attributes).hops, [&](const NextHop& each) {
            return each.interfaceIndex != interfaceIndex;
        });
    });
    return found;
}

bool hasAdvertisedRoute(Bytes buffer, std::uint32_t interfaceIndex) {
    bool found = false;
    forEachRoute(buffer, [&](const rtmsg& header, const Attributes& attributes) {
        found |= header.rtm_family == AF_INET6 && header.rtm_protocol == RTPROT_RA &&
                 routeOf(header, attributes).over(interfaceIndex) != nullptr;
    });
    return found;
}

bool isReachable(Bytes buffer, std::uint32_t interfaceIndex, Bytes address) {
    bool found = false;
    forEachOfType<ndmsg>(RTM_NEWNEIGH, buffer, [&](const ndmsg& header, const Attributes& attributes) {
        if (header.ndm_ifindex != static_cast<int>(interfaceIndex)) return;
        const auto of = attributes.find(NDA_DST);
        found |= of && std::ranges::equal(*of, address) && (header.ndm_state & NUD_REACHABLE) != 0;
    });
    return found;
}

}  // namespace wp
