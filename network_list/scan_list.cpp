#include "network_list/scan_list.h"

#include <algorithm>

namespace wp {

void ScanList::addNetwork(const WiFiScanResultPointer& network) {
    if (!network) return;
    filteredWiFiScanResults.push_back(network);
    filteredNetworks.set(network);
}

void ScanList::removeNetwork(const WiFiScanResultPointer& network) {
    if (!network) return;
    std::erase(filteredWiFiScanResults, network);
    if (network->ssid) filteredNetworks.remove(*network->ssid);
}

void ScanList::sort(const Localization& localization, const ScanList* known) {
    auto keyOf = [&](const std::string& name) -> const std::string& {
        auto [own, isNew] = collationKeys.try_emplace(name);
        if (!isNew) return own->second;
        if (known) {
            auto found = known->collationKeys.find(name);
            if (found != known->collationKeys.end()) return own->second = found->second;
        }
        return own->second = localization.collationKey(name);
    };
    struct Keyed {
        const std::string* key;
        WiFiScanResultPointer network;
    };
    std::vector<Keyed> keyed;
    keyed.reserve(filteredWiFiScanResults.size());
    for (WiFiScanResultPointer& network : filteredWiFiScanResults)
        keyed.push_back({&keyOf(*network->ssid), std::move(network)});
    std::stable_sort(keyed.begin(), keyed.end(),
                     [](const Keyed& left, const Keyed& right) { return *left.key < *right.key; });
    std::transform(keyed.begin(), keyed.end(), filteredWiFiScanResults.begin(),
                   [](Keyed& entry) { return std::move(entry.network); });
}

namespace {

// Absent strings equal nothing, not even one another.
bool areEqual(const std::optional<std::string>& left, const std::optional<std::string>& right) {
    return left && right && *left == *right;
}

}  // namespace

WiFiScanResultPointer reduceScan(const ArrayPointer& wifiScanResults, const WiFiStatusPointer& status,
                                 ScanList& list) {
    list.filteredNetworks = {};
    list.distinctNetworks = {};
    WiFiScanResultPointer joined;
    static const Array nothing;
    static const WiFiStatus notConnected;
    const WiFiStatus& connected = status ? *status : notConnected;
    for (const Value& value : wifiScanResults ? *wifiScanResults : nothing) {
        WiFiScanResultPointer entry = value.asRecord<WiFiScanResult>();
        if (!entry || !entry->ssid) continue;
        if (areEqual(connected.bssid, entry->bssid)) {
            joined = entry;
            list.distinctNetworks.set(std::move(entry));
        } else if (!areEqual(connected.ssid, entry->ssid)) {
            WiFiScanResultPointer held = list.filteredNetworks.network(entry->ssid);
            if (held && entry->rssi <= held->rssi) continue;
            list.filteredNetworks.set(entry);
            list.distinctNetworks.set(std::move(entry));
        }
    }
    list.filteredWiFiScanResults = list.filteredNetworks.values();
    return joined;
}

}  // namespace wp
