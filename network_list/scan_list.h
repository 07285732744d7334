#pragma once

#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "network_list/network_dictionary.h"
#include "platform/localization.h"
#include "platform/records.h"
#include "platform/value.h"

namespace wp {

using NetworkArray = std::vector<WiFiScanResultPointer>;

/// What a scan comes down to: the networks that can be named and those that can be chosen. *Any* thread, one
/// at a time.
struct ScanList {
    /// One entry for each name: the joined access point under the joined name, the strongest one of every
    /// other name.
    NetworkDictionary distinctNetworks;
    /// The choosable networks; `filteredWiFiScanResults` holds the same ones in the order of display.
    NetworkDictionary filteredNetworks;
    NetworkArray filteredWiFiScanResults;
    /// What the names sort by, worked out once for each.
    std::unordered_map<std::string, std::string> collationKeys;

    /// Both do nothing with null. Added at the end; removed wherever the very entry stands.
    void addNetwork(const WiFiScanResultPointer& network);
    void removeNetwork(const WiFiScanResultPointer& network);

    /// Sorts the choosable networks by name in the user's collation; those that collate as equal stay in
    /// their order. Keys that the other list (null: none) knows are taken from there.
    void sort(const Localization& localization, const ScanList* known = nullptr);
};

/// Reduces the scan to a list that is not yet sorted: hidden networks are left out; of several access points
/// of one name the strongest stays, of equally strong ones the first. The joined access point stands in
/// `distinctNetworks` only and is returned (null when it was not heard); the joined network's others stand
/// nowhere. An absent scan gives an empty list.
WiFiScanResultPointer reduceScan(const ArrayPointer& wifiScanResults, const WiFiStatusPointer& status,
                                 ScanList& list);

/// One rebuilding of the list, with copies of all that it depends on. Filled on *Main*, worked on in the
/// *Background*, taken over on *Main*.
struct ScanJob {
    std::shared_ptr<const ScanList> listBefore;
    /// The joined access point of earlier scans; null when none heard it.
    WiFiScanResultPointer rememberedNetwork;
    bool hadSelection = false;
    bool isRescan = false;

    /// The selected name that the list is built for.
    std::optional<std::string> selectedName;
    WiFiStatusPointer status;
    ArrayPointer wifiScanResults;

    WiFiScanResultPointer currentNetwork;
    ScanList list;

    std::optional<std::string> connectedSSID() const { return status ? status->ssid : std::nullopt; }
};

}  // namespace wp
