#include "linux/link_master.h"

#include <linux/if_bonding.h>
#include <linux/if_bridge.h>
#include <linux/if_link.h>
#include <linux/rtnetlink.h>

#include <algorithm>
#include <map>

#include "linux/netlink_reader.h"

namespace wp {
namespace {

constexpr int kMostLevels = 4;

/// One interface, as the kernel tells of it.
struct Record {
    std::string name, kind;
    std::uint32_t master = 0;     ///< 0 where it is part of nothing
    bool sendsElsewhere = false;  ///< as a part: it stands by, or is kept from sending
};

/// A bond's part that stands by; a bridge's part that does not forward.
bool standsBy(const Attributes& info) {
    const std::string kind = info.text(IFLA_INFO_SLAVE_KIND).value_or("");
    const Attributes state = info.nested(IFLA_INFO_SLAVE_DATA);
    if (kind == "bond") return state.number<std::uint8_t>(IFLA_BOND_SLAVE_STATE) == BOND_STATE_BACKUP;
    const auto forwards = state.number<std::uint8_t>(IFLA_BRPORT_STATE);
    return kind == "bridge" && forwards && *forwards != BR_STATE_FORWARDING;
}

/// Masters that take all that their parts send and receive.
bool hasAddressesOfParts(const std::string& kind) {
    constexpr const char* kKinds[] = {"bridge", "bond", "team"};
    return std::ranges::find(kKinds, kind) != std::end(kKinds);
}

std::map<std::uint32_t, Record> recordsIn(Bytes buffer) {
    std::map<std::uint32_t, Record> records;
    forEachOfType<ifinfomsg>(RTM_NEWLINK, buffer, [&](const ifinfomsg& header, const Attributes& attributes) {
        const Attributes info = attributes.nested(IFLA_LINKINFO);
        records[static_cast<std::uint32_t>(header.ifi_index)] = {
            attributes.text(IFLA_IFNAME).value_or(""), info.text(IFLA_INFO_KIND).value_or(""),
            attributes.number<std::uint32_t>(IFLA_MASTER).value_or(0), standsBy(info)};
    });
    return records;
}

}  // namespace

std::optional<LinkMaster> readMaster(Bytes buffer, std::uint32_t interfaceIndex) {
    const auto records = recordsIn(buffer);
    std::optional<LinkMaster> outermost;
    bool sendsElsewhere = false;
    auto part = records.find(interfaceIndex);
    for (int level = 0; level < kMostLevels && part != records.end(); ++level) {
        const auto whole = records.find(part->second.master);
        if (whole == records.end() || !hasAddressesOfParts(whole->second.kind)) break;
        sendsElsewhere |= part->second.sendsElsewhere;
        outermost = LinkMaster{whole->second.name, whole->first, sendsElsewhere};
        part = whole;
    }
    return outermost;
}

}  // namespace wp
