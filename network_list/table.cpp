#include "lifecycle/wifi_profile_view_controller.h"
#include "network_list/scan_list.h"
#include "network_list/sections.h"
#include "network_list/wifi_header_view.h"
#include "platform/localization.h"

namespace wp {
namespace {

constexpr const char* kCellIdentifier = "cellIdentifier";

}  // namespace

void WiFiProfileViewController::displayNetworkList() {
    platform_.backgroundQueue.async([self = self(), job = beginScanJob(Scan::first)]() mutable {
        self->determineCurrentNetwork();
        WiFiStatusPointer status = self->wifiStatus();
        std::optional<std::string> connectedName = status ? status->ssid : std::nullopt;
        if (!job->selectedName) job->selectedName = connectedName;
        self->platform_.mainQueue.async([self, connectedName] { self->adoptConnectedName(connectedName); });
        self->scanForJob(*job);
        self->platform_.mainQueue.async([self, job = std::move(job)] { self->showFirstList(*job); });
    });
}

/// The name is set in the step that shows it, so that a change of the selection before it finds the table and
/// the name in agreement; the user may have typed a name since.
void WiFiProfileViewController::adoptConnectedName(const std::optional<std::string>& connectedName) {
    inputs_->setSelectedNetworkNameIfAbsent(connectedName);
    if (tableView_) tableView_->reloadData();
    if (inputs_->selectedNetworkName()) enableRightBarButtonItem(true);
}

void WiFiProfileViewController::showFirstList(ScanJob& job) {
    publish(job);
    hideSpinner();
    setupRefreshControl();
    loadInitialNetworkList();
    scrollToLastFocusedItem();
}

void WiFiProfileViewController::setupRefreshControl() {
    refreshEnabled_ = true;
}

void WiFiProfileViewController::showSpinner() {
    scanFinished_ = false;
    if (networksGroupHeaderView_ && networksGroupHeaderView_->spinner())
        networksGroupHeaderView_->spinner()->startAnimating();
}

void WiFiProfileViewController::hideSpinner() {
    scanFinished_ = true;
    if (networksGroupHeaderView_ && networksGroupHeaderView_->spinner())
        networksGroupHeaderView_->spinner()->stopAnimating();
}

void WiFiProfileViewController::enableTableViewSelection(bool enable) {
    if (tableView_) tableView_->setAllowsSelection(enable);
}

void WiFiProfileViewController::enableRightBarButtonItem(bool) {}

void WiFiProfileViewController::removeNavigationBarButtons() {}

void WiFiProfileViewController::reloadRefreshCell() {
    if (tableView_) tableView_->reloadRows({{0, sections::kRefresh}}, ui::RowAnimation::fade);
}

void WiFiProfileViewController::scrollToSelectedNetwork() {
    if (!tableView_) return;
    tableView_->scrollToRow({0, sections::kSelectedNetwork}, ui::SettingsTableView::ScrollPosition::none,
                            ui::Animated::yes);
}

void WiFiProfileViewController::scrollToLastFocusedItem() {
    std::optional<ui::IndexPath> last = tableView_ ? tableView_->lastFocusedIndexPath() : std::nullopt;
    if (last) tableView_->scrollToRow(*last, ui::SettingsTableView::ScrollPosition::none, ui::Animated::yes);
}

int WiFiProfileViewController::networksOffset() const {
    return static_cast<int>(filteredWiFiScanResults().size()) + 1;
}

int WiFiProfileViewController::numberOfSectionsInTableView(ui::SettingsTableView&) {
    return sections::kCount;
}

int WiFiProfileViewController::tableViewNumberOfRowsInSection(ui::SettingsTableView&, int section) {
    switch (section) {
        case sections::kSelectedNetwork:
            return inputs_->selectedNetworkName() ? 1 : 0;
        case sections::kChoosableNetworks:
            return networksOffset() - 1;
        case sections::kOtherNetwork:
        case sections::kRefresh:
            return 1;
        default:
            return 0;
    }
}

std::optional<std::string> WiFiProfileViewController::tableViewTitleForHeaderInSection(ui::SettingsTableView&,
                                                                                       int section) {
    if (section == sections::kSelectedNetwork && inputs_->selectedNetworkName())
        return platform_.localization.localizedString("SELECTED_NETWORK");
    if (section == sections::kChoosableNetworks)
        return platform_.localization.localizedString("CHOOSE_NETWORK");
    return std::nullopt;
}

double WiFiProfileViewController::tableViewHeightForHeaderInSection(ui::SettingsTableView&, int section) {
    bool hasTitle = section == sections::kSelectedNetwork || section == sections::kChoosableNetworks;
    return hasTitle ? ui::SettingsTableView::kAutomaticDimension : ui::SettingsTableView::kSmallestPositive;
}

double WiFiProfileViewController::tableViewHeightForFooterInSection(ui::SettingsTableView&, int section) {
    return section == sections::kSelectedNetwork ? ui::SettingsTableView::kAutomaticDimension
                                                 : ui::SettingsTableView::kSmallestPositive;
}

std::string WiFiProfileViewController::textOfRow(ui::IndexPath indexPath) const {
    switch (indexPath.section) {
        case sections::kSelectedNetwork:
            return inputs_->selectedNetworkName().value_or("");
        case sections::kChoosableNetworks:
            return filteredWiFiScanResults()[indexPath.row]->ssid.value_or("");
        case sections::kOtherNetwork:
            return platform_.localization.localizedString("OTHER");
        default:
            return platform_.localization.localizedString("REFRESH");
    }
}

bool WiFiProfileViewController::rowTakesTouches(ui::IndexPath indexPath) const {
    if (indexPath.section == sections::kSelectedNetwork) return true;
    if (indexPath.section == sections::kRefresh) return !progressScreenVisible_ && refreshEnabled_;
    return !progressScreenVisible_;
}

std::shared_ptr<ui::TableViewCell> WiFiProfileViewController::tableViewCellForRowAtIndexPath(
    ui::SettingsTableView& tableView, ui::IndexPath indexPath) {
    std::shared_ptr<ui::TableViewCell> cell = tableView.dequeueReusableCell(kCellIdentifier, indexPath);
    cell->setText(textOfRow(indexPath));
    cell->setUserInteractionEnabled(rowTakesTouches(indexPath));
    return cell;
}

void WiFiProfileViewController::tableViewDidSelectRowAtIndexPath(ui::SettingsTableView& tableView,
                                                                 ui::IndexPath indexPath) {
    switch (indexPath.section) {
        case sections::kSelectedNetwork:
            presentNetworkConfirmationAlertWithNetwork(
                distinctNetworks().network(inputs_->selectedNetworkName()), false);
            break;
        case sections::kChoosableNetworks:
            presentNetworkConfirmationAlertWithNetwork(filteredWiFiScanResults()[indexPath.row], true);
            break;
        case sections::kOtherNetwork:
            askForSSID();
            break;
        case sections::kRefresh:
            refreshNetworkList(nullptr);
            break;
        default:
            break;
    }
    tableView.deselectRow(indexPath, ui::Animated::yes);
}

bool WiFiProfileViewController::tableViewCanFocusRowAtIndexPath(ui::SettingsTableView&, ui::IndexPath) {
    return true;
}

std::optional<ui::IndexPath> WiFiProfileViewController::indexPathForPreferredFocusedViewInTableView(
    ui::SettingsTableView& tableView) {
    tableView.layoutIfNeeded();
    if (progressScreenVisible_) return ui::IndexPath{0, sections::kSelectedNetwork};
    std::vector<ui::IndexPath> visible = tableView.indexPathsForVisibleRows();
    return visible.empty() ? std::nullopt : std::optional(visible.front());
}

}  // namespace wp
