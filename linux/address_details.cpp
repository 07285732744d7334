#include "linux/address_details.h"

#include <linux/if_addr.h>
#include <linux/rtnetlink.h>

#include "linux/route_dump.h"
#include "linux/route_messages.h"

namespace wp {
namespace {

constexpr std::uint32_t kForever = 0xFFFF'FFFF;
// The attribute that says who made an address is younger than the system's headers: 1 loopback, 2 a router's
// advertisement, 3 link-local.
constexpr std::uint16_t kAddressOrigin = 11;
constexpr std::uint8_t kMadeByAdvertisement = 2, kMadeAsLinkLocal = 3;

bool lastsForever(const Attributes& attributes, std::uint32_t flags) {
    const auto times = attributes.find(IFA_CACHEINFO);
    ifa_cacheinfo info{};
    if (times && times->size() >= sizeof info) std::memcpy(&info, times->data(), sizeof info);
    return (flags & IFA_F_PERMANENT) != 0 && (!times || info.ifa_valid == kForever);
}

std::optional<AddressDetails> detailsOf(const ifaddrmsg& header, const Attributes& attributes) {
    auto bytes = attributes.find(IFA_LOCAL);
    if (!bytes) bytes = attributes.find(IFA_ADDRESS);
    const auto address = bytes ? IPAddress::fromBytes(*bytes) : std::nullopt;
    if (!address) return std::nullopt;
    const std::uint32_t flags = attributes.number<std::uint32_t>(IFA_FLAGS).value_or(header.ifa_flags);
    const std::uint8_t origin = attributes.number<std::uint8_t>(kAddressOrigin).value_or(0);
    const bool kernelMade = origin == kMadeByAdvertisement || origin == kMadeAsLinkLocal;
    return AddressDetails{{*address, lastsForever(attributes, flags), kernelMade},
                          header.ifa_prefixlen,
                          (flags & IFA_F_NOPREFIXROUTE) == 0};
}

}  // namespace

std::vector<AddressDetails> readAddressDetails(Bytes buffer, std::uint32_t interfaceIndex) {
    std::vector<AddressDetails> all;
    forEachOfType<ifaddrmsg>(RTM_NEWADDR, buffer, [&](const ifaddrmsg& header, const Attributes& attributes) {
        if (header.ifa_index != interfaceIndex) return;
        if (const auto details = detailsOf(header, attributes)) all.push_back(*details);
    });
    return all;
}

std::vector<AssignedAddress> assignedOf(const std::vector<AddressDetails>& details, bool byClient,
                                        const std::vector<IPAddress>& granted) {
    std::vector<AssignedAddress> assigned;
    for (const AddressDetails& each : details) {
        const bool isClients = byClient && !each.assigned.address.isIPv4() && !each.bringsRoute;
        assigned.push_back(each.assigned);
        assigned.back().byItself |= isClients || contains(granted, each.assigned.address);
    }
    return assigned;
}

Known<std::vector<AddressDetails>> gatherAddressDetails(std::uint32_t interfaceIndex, const Until& until) {
    const auto messages = routeDump<ifaddrmsg>(RTM_GETADDR, "addresses", until);
    if (!messages) return messages.error();
    return readAddressDetails(*messages, interfaceIndex);
}

Known<RouteSigns> gatherRouteSigns(std::uint32_t interfaceIndex, const Until& until) {
    const auto messages = routeDump<rtmsg>(RTM_GETROUTE, "routes", until);
    if (!messages) return messages.error();
    return RouteSigns{leadsElsewhere(*messages, interfaceIndex),
                      hasAdvertisedRoute(*messages, interfaceIndex)};
}

}  // namespace wp
