#include "service/scan_tests.h"

#include <cmath>
#include <set>

#include "platform/records.h"

namespace wp {
namespace {

/// The kernel keeps a hidden access point twice when it has answered a probe: once by its beacon, without a
/// name, and once with the name. The one without then adds nothing.
std::set<MacAddress> addressesWithName(const std::vector<AccessPoint>& nearby) {
    std::set<MacAddress> addresses;
    for (const AccessPoint& each : nearby) {
        if (!each.says.name.absent()) addresses.insert(each.address);
    }
    return addresses;
}

Value recordOf(const AccessPoint& accessPoint) {
    // A driver without absolute strength gives none; such an entry is the weakest.
    constexpr int kUnknownSignal = -127;
    auto record = std::make_shared<WiFiScanResult>();
    if (!accessPoint.says.name.absent()) record->ssid = textFromName(accessPoint.says.name);
    record->bssid = textOf(accessPoint.address);
    record->rssi = accessPoint.signal.value_or(kUnknownSignal);
    return record;
}

Array recordsOf(const std::vector<const AccessPoint*>& accessPoints) {
    Array records;
    for (const AccessPoint* each : accessPoints) records.push_back(recordOf(*each));
    return records;
}

}  // namespace

std::vector<const AccessPoint*> hiddenAccessPoints(const std::vector<AccessPoint>& nearby,
                                                   const std::vector<AccessPoint>& listened) {
    // An access point that hides its name answers no scan: its beacon must be waited for.
    std::set<MacAddress> told = addressesWithName(nearby);
    told.merge(addressesWithName(listened));
    std::vector<const AccessPoint*> hidden;
    for (const auto* heard : {&nearby, &listened})
        for (const AccessPoint& each : *heard)
            if (!each.directOnly && each.says.name.absent() && told.insert(each.address).second)
                hidden.push_back(&each);
    return hidden;
}

std::vector<const AccessPoint*> distinctAccessPoints(const std::vector<AccessPoint>& nearby) {
    const std::set<MacAddress> named = addressesWithName(nearby);
    std::vector<const AccessPoint*> distinct;
    for (const AccessPoint& each : nearby)
        if (!each.directOnly && (!each.says.name.absent() || !named.contains(each.address)))
            distinct.push_back(&each);
    return distinct;
}

Outcome foundHiddenNetworks(const Facts& facts) {
    if (!facts.nearby) return facts.nearby.error();
    if (!facts.listened) return facts.listened.error();
    Array hidden = recordsOf(hiddenAccessPoints(*facts.nearby, *facts.listened));
    const bool found = !hidden.empty();
    return problem(found, {{"ScanResults", std::move(hidden)}});
}

Outcome foundNoNetworks(const Facts& facts) {
    if (!facts.nearby) return facts.nearby.error();
    Array all = recordsOf(distinctAccessPoints(*facts.nearby));
    const bool none = all.empty();
    return problem(none, {{"ScanResults", std::move(all)}});
}

}  // namespace wp
