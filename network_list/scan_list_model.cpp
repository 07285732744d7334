#include "lifecycle/wifi_profile_view_controller.h"
#include "network_list/scan_list.h"

namespace wp {

std::shared_ptr<ScanList> makeScanList() {
    return std::make_shared<ScanList>();
}

void WiFiProfileViewController::dedupScanResultsToHighestRSSI(ScanJob& job) const {
    WiFiScanResultPointer joined = reduceScan(job.wifiScanResults, job.status, job.list);
    // Deliberate: a scan that does not hear the joined access point leaves the one of an earlier scan.
    job.currentNetwork = joined ? joined : job.rememberedNetwork;
}

void WiFiProfileViewController::updateFilteredNetworkListIfNeeded(ScanJob& job) const {
    std::optional<std::string> connected = job.connectedSSID();
    if (connected && job.selectedName == connected) return;
    WiFiScanResultPointer selected = job.list.distinctNetworks.network(job.selectedName);
    if (!selected) return;
    job.list.removeNetwork(selected);
    if (connected) job.list.addNetwork(job.currentNetwork);
}

/// Deliberate: unlike the first list, a rescan makes the joined network choosable whenever something was
/// selected before it, and only then; whether there is a connection now plays no part.
void WiFiProfileViewController::exchangeInRescan(ScanJob& job) const {
    std::optional<std::string> connected = job.connectedSSID();
    if (connected && job.selectedName == connected && job.hadSelection) return;
    if (!job.hadSelection) job.selectedName = connected;
    WiFiScanResultPointer selected = job.list.distinctNetworks.network(job.selectedName);
    if (!selected) return;
    job.list.removeNetwork(selected);
    if (job.hadSelection) job.list.addNetwork(job.currentNetwork);
}

void WiFiProfileViewController::sortWiFiScanResults(ScanList& list) const {
    list.sort(platform_.localization);
}

void WiFiProfileViewController::rebuild(ScanJob& job) const {
    dedupScanResultsToHighestRSSI(job);
    if (job.isRescan) {
        exchangeInRescan(job);
    } else {
        updateFilteredNetworkListIfNeeded(job);
    }
    job.list.sort(platform_.localization, job.listBefore.get());
}

std::shared_ptr<ScanJob> WiFiProfileViewController::beginScanJob(Scan scan) const {
    auto job = std::make_shared<ScanJob>();
    job->isRescan = scan == Scan::again;
    job->listBefore = list_;
    job->rememberedNetwork = currentNetwork_;
    job->selectedName = inputs_->selectedNetworkName();
    job->hadSelection = job->selectedName.has_value();
    return job;
}

void WiFiProfileViewController::scanForJob(ScanJob& job) {
    runCurrentNetworkNoScanResultsWithConfiguration(freshScanConfiguration_, currentNetworkData_);
    job.status = wifiStatus();
    job.wifiScanResults = wifiScanResults();
    rebuild(job);
}

/// Takes the list over. What the user selected since the job began, or what another scan found out, has
/// changed what the list depends on: then it is built again, here and now.
void WiFiProfileViewController::publish(ScanJob& job) {
    std::optional<std::string> selectedName = inputs_->selectedNetworkName();
    if (selectedName != job.selectedName || currentNetwork_ != job.rememberedNetwork) {
        job.hadSelection = job.hadSelection || selectedName != job.selectedName;
        job.selectedName = selectedName;
        job.rememberedNetwork = currentNetwork_;
        rebuild(job);
    }
    currentNetwork_ = job.currentNetwork;
    list_ = std::make_shared<ScanList>(std::move(job.list));
}

/// The published list, for changes: no job and no snapshot sees them.
ScanList& WiFiProfileViewController::mutableList() {
    if (list_.use_count() > 1) list_ = std::make_shared<ScanList>(*list_);
    return *list_;
}

void WiFiProfileViewController::addNetworkToFilteredNetworkList(const WiFiScanResultPointer& network) {
    mutableList().addNetwork(network);
}

void WiFiProfileViewController::removeNetworkFromFilteredNetworkList(const WiFiScanResultPointer& network) {
    mutableList().removeNetwork(network);
}

void WiFiProfileViewController::refreshNetworkList(const void*) {
    std::shared_ptr<ScanJob> job = beginScanJob(Scan::again);
    previousList_ = list_;
    enableTableViewSelection(false);
    showSpinner();
    reloadRefreshCell();
    platform_.backgroundQueue.async([self = self(), job = std::move(job)]() mutable {
        self->determineCurrentNetwork();
        self->scanForJob(*job);
        if (!job->hadSelection)
            self->platform_.mainQueue.async([self] { self->enableRightBarButtonItem(true); });
        self->platform_.mainQueue.async([self, job = std::move(job)] { self->showRescan(*job); });
    });
}

void WiFiProfileViewController::showRescan(ScanJob& job) {
    // What is in the table now: by the time of a slow scan it may be another list than when the scan began.
    bool hadSelection = inputs_->selectedNetworkName().has_value();
    previousList_ = list_;
    if (!hadSelection) inputs_->setSelectedNetworkNameIfAbsent(job.connectedSSID());
    publish(job);
    hideSpinner();
    enableTableViewSelection(true);
    if (!tableView_) return;
    tableView_->beginUpdates();
    if (inputs_->selectedNetworkName() || job.connectedSSID()) reloadSelectedNetwork(hadSelection);
    updateNetworkList();
    reloadRefreshCell();
    tableView_->endUpdates();
}

const NetworkDictionary& WiFiProfileViewController::distinctNetworks() const {
    return list_->distinctNetworks;
}

const NetworkDictionary& WiFiProfileViewController::filteredNetworks() const {
    return list_->filteredNetworks;
}

const NetworkArray& WiFiProfileViewController::filteredWiFiScanResults() const {
    return list_->filteredWiFiScanResults;
}

const NetworkDictionary& WiFiProfileViewController::previousScanFilteredNetworks() const {
    return previousList_->filteredNetworks;
}

const NetworkArray& WiFiProfileViewController::previousScanFilteredWiFiScanResults() const {
    return previousList_->filteredWiFiScanResults;
}

}  // namespace wp
