#include <algorithm>
#include <map>
#include <set>

#include "service/detail_values.h"

namespace wp {
namespace {

Details bluetoothDetails(const Facts& facts) {
    if (!facts.bluetooth) return {};
    return {{"controllers", facts.bluetooth->controllers}, {"powered", facts.bluetooth->powered}};
}

Value namedNetwork(const SavedNetwork& network) {
    return Dictionary::make({{"ssid", textFromName(network.name)}});
}

}  // namespace

Details ipv4MethodDetails(const Facts& facts) {
    Details details = ipv6MethodDetails(facts);
    if (facts.setup) details.emplace("lease", static_cast<bool>(facts.setup->leaseText));
    return details;
}

Details ipv6MethodDetails(const Facts& facts) {
    Details details;
    if (facts.setup) addText(details, "judgedBy", facts.setup->toldBy);
    return details;
}

Details nameServerDetails(const Facts& facts) {
    if (!facts.setup || !facts.setup->nameServers) return {};
    const NameServers& servers = *facts.setup->nameServers;
    std::vector<IPAddress> all = servers.manual;
    for (const auto* more : {&servers.effective, &servers.offered})
        for (const IPAddress& each : *more)
            if (!contains(all, each)) all.push_back(each);
    return {{"offerKnown", servers.offerKnown},
            {"servers", listOf(all, [&](const IPAddress& each) {
                 return Dictionary::make({{"address", each.text()},
                                          {"manual", contains(servers.manual, each)},
                                          {"asked", contains(servers.effective, each)},
                                          {"offered", contains(servers.offered, each)}});
             })}};
}

Details webProxyDetails(const Facts& facts) {
    if (!facts.setup || !facts.setup->proxies || facts.setup->proxies->empty()) return {};
    return {{"places", listOf(*facts.setup->proxies, [](const std::string& place) { return place; })}};
}

Details pairedDetails(const Facts& facts) {
    Details details = bluetoothDetails(facts);
    addThresholds(details, {{"devices", facts.settings.thresholds.bluetooth.paired}});
    return details;
}

Details connectedDetails(const Facts& facts) {
    Details details = bluetoothDetails(facts);
    addThresholds(details, {{"devices", facts.settings.thresholds.bluetooth.connected}});
    return details;
}

Details sharedAirtimeDetails(const Facts& facts) {
    Details details = bluetoothDetails(facts);
    if (facts.bluetooth) details.emplace("connected", facts.bluetooth->connected);
    if (facts.driverSharesAirtime) details.emplace("driverShares", *facts.driverSharesAirtime);
    if (facts.link && facts.link->joined) details.emplace("band", wordOf(facts.link->joined->band()));
    return details;
}

Details peerLinkDetails(const Facts& facts) {
    if (!facts.peerLinks) return {};
    Details details{{"links", listOf(facts.peerLinks->links, [](const PeerLink& link) {
                         Details entry{{"interface", link.interfaceName}};
                         if (link.frequency != 0) entry.emplace("frequency", link.frequency);
                         return Dictionary::make(std::move(entry));
                     })}};
    if (facts.peerLinks->stationFrequency != 0)
        details.emplace("stationFrequency", facts.peerLinks->stationFrequency);
    addKnown(details, "indicated", facts.peerLinks->indicated);
    return details;
}

Details savedConflictDetails(const Facts& facts) {
    if (!facts.saved) return {};
    Array conflicting;
    for (const auto& [name, kinds] : conflictingNames(*facts.saved)) {
        conflicting.push_back(Dictionary::make(
            {{"ssid", textFromName(NetworkName(name))},
             {"security", listOf(kinds, [](SavedSecurity kind) { return static_cast<int>(kind); })}}));
    }
    return {{"store", facts.saved->store}, {"networks", std::move(conflicting)}};
}

Details savedCountDetails(const Facts& facts) {
    Details details;
    if (facts.saved) details.emplace("store", facts.saved->store);
    addThresholds(details, {{"networks", facts.settings.thresholds.saved.count}});
    return details;
}

Details savedHiddenDetails(const Facts& facts) {
    if (!facts.saved) return {};
    std::vector<SavedNetwork> hidden;
    std::ranges::copy_if(facts.saved->networks, std::back_inserter(hidden), &SavedNetwork::hidden);
    return {{"store", facts.saved->store}, {"networks", listOf(hidden, namedNetwork)}};
}

}  // namespace wp
