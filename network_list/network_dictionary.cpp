#include "network_list/network_dictionary.h"

namespace wp {

WiFiScanResultPointer NetworkDictionary::network(const std::optional<std::string>& name) const {
    if (!name) return nullptr;
    auto found = places_.find(*name);
    return found == places_.end() ? nullptr : networks_[found->second];
}

void NetworkDictionary::set(WiFiScanResultPointer network) {
    if (!network->ssid) return;
    auto [place, isNew] = places_.try_emplace(*network->ssid, networks_.size());
    if (isNew) {
        networks_.push_back(std::move(network));
    } else {
        networks_[place->second] = std::move(network);
    }
}

void NetworkDictionary::remove(const std::string& name) {
    auto found = places_.find(name);
    if (found == places_.end()) return;
    networks_[found->second] = nullptr;
    places_.erase(found);
}

std::vector<WiFiScanResultPointer> NetworkDictionary::values() const {
    std::vector<WiFiScanResultPointer> values;
    values.reserve(places_.size());
    for (const WiFiScanResultPointer& network : networks_)
        if (network) values.push_back(network);
    return values;
}

}  // namespace wp
