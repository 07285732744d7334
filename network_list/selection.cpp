#include <algorithm>

#include "lifecycle/wifi_profile_view_controller.h"
#include "network_list/scan_list.h"
#include "network_list/sections.h"
#include "platform/localization.h"

namespace wp {
namespace {

using ui::AlertAction;
using ui::AlertController;
using ui::Animated;

/// Where the network stands: the very entry, else the one of its name, since the list may have been built
/// anew under an open question. Nothing where neither stands there.
std::optional<std::size_t> indexOf(const NetworkArray& networks, const WiFiScanResultPointer& network) {
    auto found = std::find(networks.begin(), networks.end(), network);
    if (found == networks.end())
        found = std::find_if(networks.begin(), networks.end(),
                             [&](const auto& entry) { return entry->ssid == network->ssid; });
    if (found == networks.end()) return std::nullopt;
    return static_cast<std::size_t>(found - networks.begin());
}

}  // namespace

void WiFiProfileViewController::presentNetworkConfirmationAlertWithNetwork(
    const WiFiScanResultPointer& network, bool shouldUpdate) {
    const Localization& texts = platform_.localization;
    std::string name = network ? network->ssid.value_or("") : inputs_->selectedNetworkName().value_or("");
    auto alert = std::make_shared<AlertController>(
        texts.localizedString("NETWORK_CONFIRMATION_TITLE"),
        formatted(texts.localizedString("NETWORK_CONFIRMATION_MESSAGE"), name),
        AlertController::Style::alert);
    auto confirm = [self = self(), network, shouldUpdate](AlertAction&) {
        if (shouldUpdate) self->updateSelectedNetwork(network);
        self->runTests();
    };
    alert->addAction(std::make_shared<AlertAction>(texts.localizedString("YES"), AlertAction::Style::standard,
                                                   std::move(confirm)));
    alert->addAction(
        std::make_shared<AlertAction>(texts.localizedString("NO"), AlertAction::Style::standard));
    presentAlert(std::move(alert), Animated::yes);
}

/// Makes the name the selected one and shows it; the first half of every change of the selection.
void WiFiProfileViewController::selectName(const std::optional<std::string>& name) {
    std::optional<std::string> old = inputs_->selectedNetworkName();
    previousSelectedNetworkName_ = old;
    inputs_->setSelectedNetworkName(name);
    reloadSelectedNetwork(old.has_value());
    if (!old) enableRightBarButtonItem(true);
}

/// Takes the network's row out of the choosable ones; nothing happens where it has none.
void WiFiProfileViewController::takeFromList(const WiFiScanResultPointer& network) {
    std::optional<std::size_t> index = indexOf(filteredWiFiScanResults(), network);
    if (!index) return;
    removeNetworkFromFilteredNetworkList(WiFiScanResultPointer(filteredWiFiScanResults()[*index]));
    deleteSelectedNetwork(static_cast<int>(*index));
}

/// The second half: the network that was selected before becomes choosable again. A name that no scan has
/// shown simply leaves the table.
void WiFiProfileViewController::putBackPreviousNetwork() {
    // The name asked about may have been selected under the open question.
    if (previousSelectedNetworkName_ == inputs_->selectedNetworkName()) return;
    WiFiScanResultPointer previous = distinctNetworks().network(previousSelectedNetworkName_);
    if (!previous) return;
    addNetworkToFilteredNetworkList(previous);
    sortWiFiScanResults(mutableList());
    insertPreviousSelectedNetwork(previous);
}

/// Changes as one batch of the table; before there is one the selection changes all the same.
void WiFiProfileViewController::inBatch(const std::function<void()>& changes) {
    if (tableView_) tableView_->beginUpdates();
    changes();
    if (tableView_) tableView_->endUpdates();
}

void WiFiProfileViewController::updateSelectedNetwork(const WiFiScanResultPointer& network) {
    inBatch([&] {
        selectName(network->ssid);
        takeFromList(network);
    });
    inBatch([&] { putBackPreviousNetwork(); });
}

void WiFiProfileViewController::reloadSelectedNetwork(bool hadSelection) {
    if (!tableView_) return;
    const ui::IndexPath row{0, sections::kSelectedNetwork};
    tableView_->beginUpdates();
    if (hadSelection) tableView_->deleteRows({row}, ui::RowAnimation::fade);
    tableView_->insertRows({row}, ui::RowAnimation::fade);
    tableView_->endUpdates();
}

void WiFiProfileViewController::deleteSelectedNetwork(int row) {
    if (!tableView_) return;
    ui::IndexPath indexPath;
    platform_.backgroundQueue.sync([&] { indexPath = {row, sections::kChoosableNetworks}; });
    tableView_->beginUpdates();
    tableView_->deleteRows({indexPath}, ui::RowAnimation::fade);
    tableView_->endUpdates();
}

void WiFiProfileViewController::insertPreviousSelectedNetwork(const WiFiScanResultPointer& network) {
    std::optional<std::size_t> index;
    platform_.backgroundQueue.sync([&] { index = indexOf(filteredWiFiScanResults(), network); });
    if (!tableView_ || !index) return;
    const ui::IndexPath indexPath{static_cast<int>(*index), sections::kChoosableNetworks};
    tableView_->beginUpdates();
    tableView_->insertRows({indexPath}, ui::RowAnimation::fade);
    tableView_->endUpdates();
}

void WiFiProfileViewController::askForSSID() {
    const Localization& texts = platform_.localization;
    auto alert = std::make_shared<AlertController>(
        std::nullopt, texts.localizedString("OTHER_NETWORK_MESSAGE"), AlertController::Style::alert);
    // The alert keeps its actions: they must not keep the alert.
    auto takeOver = [self = self(), weakAlert = std::weak_ptr(alert)](AlertAction&) {
        auto shown = weakAlert.lock();
        if (shown) self->updateSelectedNetworkFromOtherWithSSID(shown->textFields().front()->text());
    };
    auto done = std::make_shared<AlertAction>(texts.localizedString("DONE"), AlertAction::Style::standard,
                                              std::move(takeOver));
    done->setEnabled(false);
    alert->addTextField([&](ui::TextField& field) {
        field.setDictationDisabled(true);
        field.setPlaceholder(texts.localizedString("OTHER_NETWORK_PLACEHOLDER"));
        field.addTarget([self = self()](ui::TextField& changed) { self->textFieldAlertDidChange(changed); });
    });
    alert->addAction(
        std::make_shared<AlertAction>(texts.localizedString("CANCEL"), AlertAction::Style::cancel));
    alert->addAction(std::move(done));
    presentAlert(std::move(alert), Animated::yes);
}

void WiFiProfileViewController::textFieldAlertDidChange(ui::TextField&) {
    std::shared_ptr<AlertController> alert = presentedAlert();
    if (!alert || alert->textFields().empty() || alert->actions().empty()) return;
    alert->actions().back()->setEnabled(!alert->textFields().front()->text().empty());
}

void WiFiProfileViewController::updateSelectedNetworkFromOtherWithSSID(const std::string& ssid) {
    if (inputs_->selectedNetworkName() == ssid) return;
    inBatch([&] {
        selectName(ssid);
        if (WiFiScanResultPointer listed = filteredNetworks().network(ssid)) takeFromList(listed);
    });
    inBatch([&] { putBackPreviousNetwork(); });
}

}  // namespace wp
