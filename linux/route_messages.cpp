#include "linux/route_messages.h"

#include <arpa/inet.h>
#include <linux/if_addr.h>
#include <linux/neighbour.h>
#include <linux/rtnetlink.h>

#include <algorithm>
#include <array>

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

/// The next hop; one of the other family stands behind two bytes that name it.
std::optional<Gateway> nextHop(Address::Family family, const Attributes& attributes) {
    std::optional<Bytes> bytes = attributes.find(RTA_GATEWAY);
    if (!bytes) {
        const std::optional<Bytes> via = attributes.find(RTA_VIA);
        if (!via || via->size() < 2) return std::nullopt;
        const std::optional<Address::Family> named = familyOf((*via)[0]);
        if (!named) return std::nullopt;
        family = *named;
        bytes = via->subspan(2);
    }
    if (bytes->size() != sizeOf(family)) return std::nullopt;
    return Gateway{family, {bytes->begin(), bytes->end()}, 0};
}

/// A route with several next hops names each behind a header of its own.
std::optional<Gateway> nextHopAmong(Address::Family family, Bytes hops, std::uint32_t interfaceIndex) {
    rtnexthop header;
    while (hops.size() >= sizeof header) {
        std::memcpy(&header, hops.data(), sizeof header);
        if (header.rtnh_len < sizeof header || header.rtnh_len > hops.size()) return std::nullopt;
        const Attributes attributes(hops.subspan(sizeof header, header.rtnh_len - sizeof header));
        if (header.rtnh_ifindex == static_cast<int>(interfaceIndex)) return nextHop(family, attributes);
        hops = hops.subspan(std::min<std::size_t>((header.rtnh_len + 3U) & ~3U, hops.size()));
    }
    return std::nullopt;
}

bool isDefaultRoute(const rtmsg& header) {
    return header.rtm_dst_len == 0 && header.rtm_type == RTN_UNICAST;
}

std::optional<Gateway> gatewayOf(const rtmsg& header, const Attributes& attributes,
                                 std::uint32_t interfaceIndex) {
    const std::optional<Address::Family> family = familyOf(header.rtm_family);
    const std::uint32_t table = attributes.number<std::uint32_t>(RTA_TABLE).value_or(header.rtm_table);
    if (!isDefaultRoute(header) || !family || table != RT_TABLE_MAIN) return std::nullopt;
    std::optional<Gateway> gateway;
    if (const auto hops = attributes.find(RTA_MULTIPATH)) {
        gateway = nextHopAmong(*family, *hops, interfaceIndex);
    } else if (attributes.number<std::uint32_t>(RTA_OIF) == interfaceIndex) {
        gateway = nextHop(*family, attributes);
    }
    if (gateway) gateway->metric = attributes.number<std::uint32_t>(RTA_PRIORITY).value_or(0);
    return gateway;
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

std::vector<Gateway> readGateways(Bytes buffer, std::uint32_t interfaceIndex) {
    std::vector<Gateway> gateways;
    forEachRoute(buffer, [&](const rtmsg& header, const Attributes& attributes) {
        std::optional<Gateway> gateway = gatewayOf(header, attributes, interfaceIndex);
        if (gateway) gateways.push_back(std::move(*gateway));
    });
    std::ranges::stable_sort(gateways, [](const Gateway& left, const Gateway& right) {
        return left.family != right.family ? left.family == Address::Family::ipv4
                                           : left.metric < right.metric;
    });
    return gateways;
}

bool leadsElsewhere(Bytes buffer, std::uint32_t interfaceIndex) {
    bool found = false;
    forEachRoute(buffer, [&](const rtmsg& header, const Attributes& attributes) {
        if (!isDefaultRoute(header)) return;
        const auto out = attributes.number<std::uint32_t>(RTA_OIF);
        // A route with several next hops leads over several interfaces as a rule.
        found |= out ? *out != interfaceIndex : attributes.has(RTA_MULTIPATH);
    });
    return found;
}

bool hasAdvertisedRoute(Bytes buffer, std::uint32_t interfaceIndex) {
    bool found = false;
    forEachRoute(buffer, [&](const rtmsg& header, const Attributes& attributes) {
        if (header.rtm_family != AF_INET6 || header.rtm_protocol != RTPROT_RA) return;
        const auto hops = attributes.find(RTA_MULTIPATH);
        found |= hops ? nextHopAmong(Address::Family::ipv6, *hops, interfaceIndex).has_value()
                      : attributes.number<std::uint32_t>(RTA_OIF) == interfaceIndex;
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

std::string textOf(Address::Family family, Bytes address) {
    std::array<char, INET6_ADDRSTRLEN> text{};
    if (address.size() != sizeOf(family)) return {};
    inet_ntop(family == Address::Family::ipv4 ? AF_INET : AF_INET6, address.data(), text.data(), text.size());
    return text.data();
}

}  // namespace wp
