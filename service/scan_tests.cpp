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

}  // namespace

Outcome foundHiddenNetworks(const Facts& facts) {
    if (!facts.nearby) return facts.nearby.error();
    if (!facts.listened) return facts.listened.error();
    // An access point that hides its name answers no scan: its beacon must be waited for.
    std::vector<AccessPoint> all = *facts.nearby;
    all.insert(all.end(), facts.listened->begin(), facts.listened->end());
    std::set<MacAddress> told = addressesWithName(all);
    Array hidden;
    for (const AccessPoint& each : all) {
        if (each.says.name.absent() && told.insert(each.address).second) hidden.push_back(recordOf(each));
    }
    const bool found = !hidden.empty();
    return problem(found, {{"ScanResults", std::move(hidden)}});
}

Outcome foundNoNetworks(const Facts& facts) {
    if (!facts.nearby) return facts.nearby.error();
    const std::set<MacAddress> named = addressesWithName(*facts.nearby);
    Array all;
    for (const AccessPoint& each : *facts.nearby) {
        if (!each.says.name.absent() || !named.contains(each.address)) all.push_back(recordOf(each));
    }
    const bool none = all.empty();
    return problem(none, {{"ScanResults", std::move(all)}});
}

}  // namespace wp
