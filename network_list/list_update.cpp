#include "lifecycle/wifi_profile_view_controller.h"
#include "network_list/scan_list.h"
#include "network_list/sections.h"

namespace wp {
namespace {

/// The rows of the networks that the dictionary does not know by name.
std::vector<ui::IndexPath> rowsMissingIn(const NetworkDictionary& dictionary, const NetworkArray& networks) {
    std::vector<ui::IndexPath> rows;
    for (std::size_t row = 0; row < networks.size(); ++row)
        if (!dictionary.contains(*networks[row]->ssid))
            rows.push_back({static_cast<int>(row), sections::kChoosableNetworks});
    return rows;
}

}  // namespace

void WiFiProfileViewController::loadInitialNetworkList() {
    std::vector<ui::IndexPath> rows;
    rows.reserve(filteredWiFiScanResults().size());
    platform_.backgroundQueue.sync([&] {
        for (std::size_t row = 0; row < filteredWiFiScanResults().size(); ++row)
            rows.push_back({static_cast<int>(row), sections::kChoosableNetworks});
    });
    if (!tableView_) return;
    tableView_->beginUpdates();
    reloadRefreshCell();
    tableView_->insertRows(rows, ui::RowAnimation::fade);
    tableView_->endUpdates();
}

void WiFiProfileViewController::updateNetworkList() {
    if (!tableView_) return;
    tableView_->beginUpdates();
    deleteLostNetworks();
    insertNewNetworks();
    tableView_->endUpdates();
}

void WiFiProfileViewController::deleteLostNetworks() {
    std::vector<ui::IndexPath> lost;
    platform_.backgroundQueue.sync(
        [&] { lost = rowsMissingIn(filteredNetworks(), previousScanFilteredWiFiScanResults()); });
    if (!tableView_) return;
    tableView_->beginUpdates();
    tableView_->deleteRows(lost, ui::RowAnimation::fade);
    tableView_->endUpdates();
}

void WiFiProfileViewController::insertNewNetworks() {
    std::vector<ui::IndexPath> found;
    platform_.backgroundQueue.sync(
        [&] { found = rowsMissingIn(previousScanFilteredNetworks(), filteredWiFiScanResults()); });
    if (!tableView_) return;
    tableView_->beginUpdates();
    tableView_->insertRows(found, ui::RowAnimation::fade);
    tableView_->endUpdates();
}

}  // namespace wp
