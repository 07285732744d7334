#include "service/saved_networks.h"

#include <algorithm>

namespace wp {
namespace {

/// One number for all that can stand for each other.
int kindOf(SavedSecurity security) {
    const bool personal = security == SavedSecurity::wpaPersonal || security == SavedSecurity::sae;
    return static_cast<int>(personal ? SavedSecurity::wpa2Personal : security);
}

}  // namespace

Outcome remembersManyNetworks(const Known<SavedNetworks>& saved, const SavedNetworkLimits& limits) {
    if (!saved) return saved.error();
    const std::uint64_t count = saved->networks.size();
    return problem(count > limits.count, {{"PNLCount", count}});
}

Outcome remembersHiddenNetworks(const Known<SavedNetworks>& saved) {
    if (!saved) return saved.error();
    return problem(std::any_of(saved->networks.begin(), saved->networks.end(),
                               [](const SavedNetwork& network) { return network.hidden; }));
}

std::map<std::vector<std::uint8_t>, std::set<SavedSecurity>> conflictingNames(const SavedNetworks& saved) {
    std::map<std::vector<std::uint8_t>, std::set<SavedSecurity>> names;
    for (const SavedNetwork& network : saved.networks) {
        if (!network.enabled || network.security == SavedSecurity::unknown) continue;
        const Bytes bytes = network.name.bytes();
        names[{bytes.begin(), bytes.end()}].insert(network.security);
    }
    std::erase_if(names, [](const auto& entry) {
        std::set<int> kinds;
        for (const SavedSecurity security : entry.second) kinds.insert(kindOf(security));
        return kinds.size() < 2;
    });
    return names;
}

Outcome remembersConflictingSecurity(const Known<SavedNetworks>& saved) {
    if (!saved) return saved.error();
    return problem(!conflictingNames(*saved).empty());
}

const SavedNetwork* findSaved(const SavedNetworks& saved, const NetworkName& name) {
    const auto rank = [](const SavedNetwork& network) {
        const double joined = network.lastJoined ? network.lastJoined->secondsSinceReference : -1e18;
        return std::pair(network.enabled, joined);
    };
    const SavedNetwork* best = nullptr;
    for (const SavedNetwork& network : saved.networks) {
        if (network.name != name) continue;
        if (best == nullptr || rank(*best) < rank(network)) best = &network;
    }
    return best;
}

std::shared_ptr<const PreferredNetworkRecord> recordOf(const SavedNetwork& network, bool seenSeveralAPs) {
    auto record = std::make_shared<PreferredNetworkRecord>();
    if (!network.name.absent()) record->ssid = textFromName(network.name);
    record->security = static_cast<std::int64_t>(network.security);
    record->passpoint = network.passpoint;
    record->enabled = network.enabled;
    record->captive = network.captive;
    record->hidden = network.hidden;
    record->multiAP = network.seenSeveralAPs || seenSeveralAPs;
    record->lastJoined = network.lastJoined;
    return record;
}

}  // namespace wp
