#include "service/device_tests.h"

namespace wp {
namespace {

Known<Band> joinedBand(const Known<Link>& link) {
    if (!link) return link.error();
    return link->joined ? link->joined->band() : Band::none;
}

}  // namespace

Outcome ipv4IsCustom(const Facts& facts) {
    if (!facts.setup) return facts.setup.error();
    return usesCustomIPv4(facts.setup->methods);
}

Outcome ipv6IsCustom(const Facts& facts) {
    if (!facts.setup) return facts.setup.error();
    return usesCustomIPv6(facts.setup->methods);
}

Outcome nameServersAreCustom(const Facts& facts) {
    if (!facts.setup) return facts.setup.error();
    return usesCustomNameServers(facts.setup->nameServers);
}

Outcome webProxyIsCustom(const Facts& facts) {
    if (!facts.setup) return facts.setup.error();
    return usesCustomWebProxy(facts.setup->proxies);
}

Outcome manyBluetoothPaired(const Facts& facts) {
    return hasManyPairedBluetooth(facts.bluetooth, facts.settings.thresholds.bluetooth);
}

Outcome manyBluetoothConnected(const Facts& facts) {
    return hasManyConnectedBluetooth(facts.bluetooth, facts.settings.thresholds.bluetooth);
}

Outcome bluetoothSharesAirtime(const Facts& facts) {
    return sharesAirtimeWithBluetooth(facts.driverSharesAirtime, facts.bluetooth, joinedBand(facts.link));
}

Outcome peerLinkTakesTurns(const Facts& facts) {
    return peerLinkIsInRealTimeMode(facts.peerLinks);
}

Outcome savedSecurityConflicts(const Facts& facts) {
    return remembersConflictingSecurity(facts.saved);
}

Outcome manyNetworksSaved(const Facts& facts) {
    return remembersManyNetworks(facts.saved, facts.settings.thresholds.saved);
}

Outcome hiddenNetworksSaved(const Facts& facts) {
    return remembersHiddenNetworks(facts.saved);
}

}  // namespace wp
