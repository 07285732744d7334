#pragma once

#include <atomic>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "lifecycle/wifi_profile_inputs.h"
#include "platform/diagnostic.h"
#include "platform/diagnostics.h"
#include "platform/extension.h"
#include "platform/records.h"
#include "platform/synchronized.h"
#include "platform/ui/controls.h"
#include "platform/ui/label.h"
#include "platform/ui/table_view.h"
#include "platform/wifi_manager.h"

namespace wp {

class NetworkDictionary;
class WiFiHeaderView;
struct ScanJob;
struct ScanList;
struct TestRow;

using NetworkArray = std::vector<WiFiScanResultPointer>;
std::shared_ptr<ScanList> makeScanList();

/// The controller of the Wi-Fi diagnostic: one object lives for one run and owns all of its state.
///
/// A run: the host hands over the inputs (`setupWithInputs`) and starts it (`start`). Without the network
/// list the tests begin at once; with it the Wi-Fi manager is asked for power, the list of networks is shown,
/// and the tests begin when the user has confirmed one (`runTests`). The tests are one block on the
/// background queue: the device, then the network that the device is joined to, then the selected network,
/// one request after the other. Half a second after the last one the run ends with its status code and the
/// result document (`endTestWithStatusCode`), and the host tears it down.
///
/// Threads. *Main*: the host's calls, alerts and rows, power callbacks, every view. *Background*: the block
/// of the tests and the scans of the list. What both sides touch is atomic or a `Synchronized` value; a
/// result section synchronises inside itself. Blocks keep the controller alive.
///
/// Failures are never exceptions. A test that fails writes one log line and leaves its keys unset, and the
/// next one runs; only the conditions behind the status codes end a run.
///
/// Contents                                              source
///   1. Life of a run                                    lifecycle/run.cpp
///   2. Wi-Fi power                                      lifecycle/wifi_power.cpp
///   3. Phases and result document                       lifecycle/phases.cpp
///   4. Progress screen                                  lifecycle/progress_screen.cpp
///   5. Test invocation                                  tests/test_invocation.cpp
///   6. Device configuration tests                       tests/device_configuration_tests.cpp
///   7. Current-network tests: properties                tests/network_property_tests.cpp
///   8. Current-network tests: connectivity              tests/connectivity_tests.cpp
///   9. Current-network tests: channel, signal, scan     tests/channel_tests.cpp
///  10. Selected-network tests                           tests/selected_network_tests.cpp
///  11. Scan list model                                  network_list/scan_list_model.cpp
///  12. Incremental list update                          network_list/list_update.cpp
///  13. Selection, confirmation, other network           network_list/selection.cpp
///  14. Network list table                               network_list/table.cpp
///  15. Screen layout and views                          network_list/screen_layout.cpp
class WiFiProfileViewController final : public DiagnosticViewController,
                                        public ui::TableViewDataSource,
                                        public ui::TableViewDelegate {
  public:
    using Configuration = const DictionaryPointer&;
    using Results = const DictionaryPointer&;

    /// *Main*. The platform outlives the controller and every block of it.
    explicit WiFiProfileViewController(Platform& platform) : platform_(platform) {}
    ~WiFiProfileViewController() override;

    // 1. Life of a run -- lifecycle/run.cpp -----------------------------------------------------------------

    /// Keeps the inputs and makes the run's state: counters at 0, the configurations that do not depend on
    /// the selection, three empty result sections. *Main*; the responder is not used.
    void setupWithInputs(std::shared_ptr<DiagnosticInputs> inputs, DiagnosticResponder* responder) override;

    /// Begins the run: straight with the tests, or with the list of networks; then builds the screen. *Main*.
    void start() override;

    /// Cleans up; the result is left as it is. *Main*.
    void teardown() override;

    /// Asks the service which network the device is joined to and keeps the answer as `wifiStatus`. When the
    /// query fails it logs that and leaves `wifiStatus` as it was; an answer without a status makes it
    /// absent. *Any* thread; blocks.
    void determineCurrentNetwork();

    /// What a "next" button calls: `runTests`. *Main*; the sender is ignored.
    void nextTapped(const void* sender);

    /// Shows the progress screen and submits the test run to the background queue. Does nothing while a test
    /// run is under way or once the run is over. *Main*.
    void runTests();

    /// Ends the run: cleans up, seals the result with the code and the live result sections, and marks the
    /// run finished. The first call counts; a later one does nothing. *Any* thread.
    ///
    /// 0 completed; -2 no Wi-Fi manager client; -3 no Wi-Fi device; -4 Wi-Fi off and the user declined to
    /// turn it on; -5 Wi-Fi went off while the list was in use; -6, -7 the current, the selected network asks
    /// by its name ("_nomap") not to be measured (-7 wins).
    void endTestWithStatusCode(int statusCode);

    /// Cancels the service's outstanding requests and releases the Wi-Fi handles, the power callback first.
    /// Calling it again is harmless. *Any* thread.
    void cleanUp();

    /// Tells the host that the run is over. *Any* thread.
    void finishTest();

    /// Once the run is over no key and no action of an alert reaches it any more.
    bool acceptsInput() const override { return !ended_; }

    const std::shared_ptr<WiFiProfileInputs>& inputs() const { return inputs_; }
    /// {"MaxScanCacheAge": the inputs' value}; for every test of the current network.
    const DictionaryPointer& currentNetworkConfiguration() const { return currentNetworkConfiguration_; }
    /// {"MaxScanCacheAge": 0}; for the list's scans.
    const DictionaryPointer& freshScanConfiguration() const { return freshScanConfiguration_; }
    /// {"MaxScanCacheAge", "NetworkName": the selected name}, or the very `currentNetworkConfiguration` when
    /// none is selected; for the device's and the selected network's tests. Null before the tests begin.
    const DictionaryPointer& configuration() const { return configuration_; }
    /// The network that the device is joined to, as the last successful query told; null before one.
    WiFiStatusPointer wifiStatus() const { return wifiStatus_.get(); }
    void setWifiStatus(WiFiStatusPointer status) { wifiStatus_.set(std::move(status)); }

    // 2. Wi-Fi power -- lifecycle/wifi_power.cpp ------------------------------------------------------------

    /// Gets the Wi-Fi manager client, its first device and the power state, and registers for power changes
    /// on the caller's run loop. Without a client or a device it logs that, ends the run (-2, -3) and returns
    /// false. *Main*.
    bool setupWiFi();

    /// Asks the user to turn Wi-Fi on. *Main*.
    void presentWiFiPoweredOffAlert();

    /// Wi-Fi power has changed: off ends the run (-5), on shows the list. Does nothing without a manager or
    /// once the run is over. *Main*.
    void powerChanged();

    bool wifiPoweredOn() const { return wifiPoweredOn_; }

    // 3. Phases and result document -- lifecycle/phases.cpp -------------------------------------------------

    /// Each runs the tests of its phase in their fixed order, each followed by `updateProgress`, and never
    /// stops early. *Background*; blocks.
    void runDeviceConfigurationDiagnosticsTests();
    void runCurrentNetworkDiagnosticsTests();
    void runSelectedNetworkDiagnosticsTests();

    /// The date as ISO 8601 text in UTC. *Any* thread.
    std::string timestampFormattedInISO8601(Date date) const;

    /// The result sections, empty at set-up, filled by the tests, part of the result document as they are.
    const DictionaryPointer& deviceData() const { return deviceData_; }
    const DictionaryPointer& currentNetworkData() const { return currentNetworkData_; }
    const DictionaryPointer& selectedNetworkData() const { return selectedNetworkData_; }

    // 4. Progress screen -- lifecycle/progress_screen.cpp ---------------------------------------------------

    /// Turns the screen into the progress screen. *Main*; before the views exist it changes nothing visible.
    void showProgress();

    /// Counts one more test as done and lets the bar follow on the main queue. *Any* thread; returns at once.
    void updateProgress();

    /// Builds a progress screen from scratch, in place of the list. Nothing in a run calls it: a run turns the
    /// screen that it has into one by `showProgress`. *Main*.
    void displayProgressScreen();

    bool progressScreenVisible() const { return progressScreenVisible_; }
    /// Tests done so far, and tests that this run performs: 11, 27, 40 or 56. *Any* thread.
    std::int32_t completedTests() const { return completedTests_; }
    std::int32_t totalTests() const { return totalTests_; }

    // 5. Test invocation -- tests/test_invocation.cpp -------------------------------------------------------

    /// The first of the results; null, and a log line that says why, when there is none. *Any* thread.
    DiagnosticsTestResultPointer testResultFromResults(
        const std::optional<DiagnosticsTestResults>& results) const;

    // 6. Device configuration tests -- tests/device_configuration_tests.cpp ---------------------------------
    // Each asks the service for one test with `configuration` and writes `deviceData`. *Background*; blocks.

    void runDeviceConfigurationCustomIPv4();
    void runDeviceConfigurationCustomIPv6();
    void runDeviceConfigurationCustomDNS();
    void runDeviceConfigurationCustomWebProxy();
    void runDeviceConfigurationHalvoRealTimeMode();
    void runDeviceConfigurationBluetoothConnected();
    void runDeviceConfigurationBluetoothPaired();
    void runDeviceConfigurationBTCoex();
    void runDeviceConfigurationLargePNL();
    void runDeviceConfigurationPNLContainsHidden();
    void runDeviceConfigurationConflictingSecurityTypeInPNL();

    // 7. Current-network tests: properties -- tests/network_property_tests.cpp ------------------------------
    // Each asks the service for one test with the configuration given and writes only the dictionary given,
    // so that it serves the current and the selected network alike. *Background*; blocks.

    void runCurrentNetworkDetectDoubleNATWithConfiguration(Configuration configuration,
                                                           Results resultsDictionary);
    void runCurrentNetworkLongBeaconIntervalWithConfiguration(Configuration configuration,
                                                              Results resultsDictionary);
    void runCurrentNetworkLongDTIMIntervalWithConfiguration(Configuration configuration,
                                                            Results resultsDictionary);
    void runCurrentNetworkNoSecurityWithConfiguration(Configuration configuration, Results resultsDictionary);
    void runCurrentNetworkLegacySecurityWEPWithConfiguration(Configuration configuration,
                                                             Results resultsDictionary);
    void runCurrentNetworkLegacySecurityWPAWithConfiguration(Configuration configuration,
                                                             Results resultsDictionary);
    void runCurrentNetworkLegacyRates11bWithConfiguration(Configuration configuration,
                                                          Results resultsDictionary);
    void runCurrentNetworkAmbiguousNetworkNameWithConfiguration(Configuration configuration,
                                                                Results resultsDictionary);
    void runCurrentNetworkHiddenNetworkWithConfiguration(Configuration configuration,
                                                         Results resultsDictionary);
    void runCurrentNetworkPyloPersonalHotspotWithConfiguration(Configuration configuration,
                                                               Results resultsDictionary);
    void runCurrentNetworkCaptivePortalWithConfiguration(Configuration configuration,
                                                         Results resultsDictionary);
    void runCurrentNetworkPasspointWithConfiguration(Configuration configuration, Results resultsDictionary);
    void runCurrentNetworkConflictingPHYMode11ACWithConfiguration(Configuration configuration,
                                                                  Results resultsDictionary);
    void runCurrentNetworkConflictingPHYMode11NWithConfiguration(Configuration configuration,
                                                                 Results resultsDictionary);
    void runCurrentNetworkMarlixBaseStationWithConfiguration(Configuration configuration,
                                                             Results resultsDictionary);

    // 8. Current-network tests: connectivity -- tests/connectivity_tests.cpp --------------------------------
    // As in section 7, for the current network only.

    void runCurrentNetworkPingLANWithConfiguration(Configuration configuration, Results resultsDictionary);
    void runCurrentNetworkPingWANWithConfiguration(Configuration configuration, Results resultsDictionary);
    void runCurrentNetworkIPv4AssignedWithConfiguration(Configuration configuration,
                                                        Results resultsDictionary);
    void runCurrentNetworkIPv6AssignedWithConfiguration(Configuration configuration,
                                                        Results resultsDictionary);
    void runCurrentNetworkResolveDNSWithConfiguration(Configuration configuration, Results resultsDictionary);
    void runCurrentNetworkReachVantorWithConfiguration(Configuration configuration,
                                                       Results resultsDictionary);
    void runCurrentNetworkRetrieveVantorWithConfiguration(Configuration configuration,
                                                          Results resultsDictionary);

    // 9. Current-network tests: channel, signal, scan -- tests/channel_tests.cpp ----------------------------
    // As in section 7. The no-scan-results test is the list's: it is no part of the current-network phase.

    void runCurrentNetworkCongestedChannelWithConfiguration(Configuration configuration,
                                                            Results resultsDictionary);
    void runCurrentNetworkCongested2GHzWithConfiguration(Configuration configuration,
                                                         Results resultsDictionary);
    void runCurrentNetworkCongested5GHzWithConfiguration(Configuration configuration,
                                                         Results resultsDictionary);
    void runCurrentNetworkHT402GHzChannelWithConfiguration(Configuration configuration,
                                                           Results resultsDictionary);
    void runCurrentNetworkConflictingCountryCodeWithConfiguration(Configuration configuration,
                                                                  Results resultsDictionary);
    void runCurrentNetworkPoorSignalWithConfiguration(Configuration configuration, Results resultsDictionary);
    void runCurrentNetworkNoScanResultsWithConfiguration(Configuration configuration,
                                                         Results resultsDictionary);
    void runCurrentNetworkHiddenScanResultsWithConfiguration(Configuration configuration,
                                                             Results resultsDictionary);

    /// The list of `WiFiScanResult` of the latest scan that passed, the very array that the service
    /// delivered; null before one, and after one that passed without a list. *Any* thread.
    ArrayPointer wifiScanResults() const { return wifiScanResults_.get(); }
    void setWifiScanResults(ArrayPointer results) { wifiScanResults_.set(std::move(results)); }

    // 10. Selected-network tests -- tests/selected_network_tests.cpp ----------------------------------------
    // Each calls the current-network test of its name with `configuration` and `selectedNetworkData`.

    void runSelectedNetworkLongBeaconInterval();
    void runSelectedNetworkNoSecurity();
    void runSelectedNetworkLegacySecurityWEP();
    void runSelectedNetworkLegacySecurityWPA();
    void runSelectedNetworkLegacyRates11b();
    void runSelectedNetworkAmbiguousNetworkName();
    void runSelectedNetworkHiddenNetwork();
    void runSelectedNetworkPyloPersonalHotspot();
    void runSelectedNetworkCaptivePortal();
    void runSelectedNetworkPasspoint();
    void runSelectedNetworkConflictingPHYMode11AC();
    void runSelectedNetworkConflictingPHYMode11N();
    void runSelectedNetworkMarlixBaseStation();
    void runSelectedNetworkCongestedChannel();
    void runSelectedNetworkConflictingCountryCode();
    void runSelectedNetworkPoorSignal();

    // 11. Scan list model -- network_list/scan_list_model.cpp -----------------------------------------------
    // The list is built in the background, in a job that holds copies of all that it depends on, and
    // published on the main queue by the step that shows it. So the table's data source never changes under
    // the table, and no lock is needed.

    /// Rebuilds the job's collections from its scan: one entry per name, the strongest; the joined access
    /// point only in `distinctNetworks`; the joined network's other access points nowhere. *Background*.
    void dedupScanResultsToHighestRSSI(ScanJob& job) const;

    /// After the first scan: where another network than the joined one is selected, takes it out of the
    /// choosable ones and puts the joined one in. *Background*.
    void updateFilteredNetworkListIfNeeded(ScanJob& job) const;

    /// Sorts the choosable networks by name in the user's collation, case ignored; stable. *Any* thread, on a
    /// list that no other one uses.
    void sortWiFiScanResults(ScanList& list) const;

    /// Appends the network to the choosable ones, removes it from them; null does nothing. *Main*.
    void addNetworkToFilteredNetworkList(const WiFiScanResultPointer& network);
    void removeNetworkFromFilteredNetworkList(const WiFiScanResultPointer& network);

    /// Scans again and applies the difference to the table. The sender is ignored. *Main*; returns at once.
    void refreshNetworkList(const void* sender);

    /// Every network that can be named, by name. *Main*, as all of these.
    const NetworkDictionary& distinctNetworks() const;
    /// The choosable networks, by name and in the order in which the table shows them.
    const NetworkDictionary& filteredNetworks() const;
    const NetworkArray& filteredWiFiScanResults() const;
    /// The choosable networks as they were when the latest rescan began.
    const NetworkDictionary& previousScanFilteredNetworks() const;
    const NetworkArray& previousScanFilteredWiFiScanResults() const;
    /// The joined access point in the latest scan that heard it; null before one did.
    const WiFiScanResultPointer& currentNetwork() const { return currentNetwork_; }
    /// False while a scan is under way. *Any* thread.
    bool scanFinished() const { return scanFinished_; }
    /// Whether the row that scans again may be used: once the first list is shown.
    bool refreshEnabled() const { return refreshEnabled_; }

    // 12. Incremental list update -- network_list/list_update.cpp -------------------------------------------
    // All *Main*. Networks are matched by name, exactly: one that changed its strength keeps its row.

    /// Inserts the rows of the first list.
    void loadInitialNetworkList();
    /// Applies the difference between the list before the rescan and the one after it.
    void updateNetworkList();
    void deleteLostNetworks();
    void insertNewNetworks();

    // 13. Selection, confirmation, other network -- network_list/selection.cpp ------------------------------
    // All *Main*. The selection is a name and nothing else.

    /// Asks the user to confirm the network (null: the selected name, which no scan has shown); "yes" makes it
    /// the selected one where `shouldUpdate` says so, and runs the tests.
    void presentNetworkConfirmationAlertWithNetwork(const WiFiScanResultPointer& network, bool shouldUpdate);
    /// Makes a choosable network the selected one; the one selected before becomes choosable again.
    void updateSelectedNetwork(const WiFiScanResultPointer& network);
    /// Replaces the selected network's row, or creates it where there was none.
    void reloadSelectedNetwork(bool hadSelection);
    /// Deletes that row of the choosable networks.
    void deleteSelectedNetwork(int row);
    /// Inserts the row of a network that has become choosable again.
    void insertPreviousSelectedNetwork(const WiFiScanResultPointer& network);
    /// Asks the user to type a name.
    void askForSSID();
    /// Lets the typed name be taken over only while there is one.
    void textFieldAlertDidChange(ui::TextField& textField);
    /// Makes the typed name the selected one. It is taken as it stands, blanks included.
    void updateSelectedNetworkFromOtherWithSSID(const std::string& ssid);

    /// The name that was selected before the latest change.
    const std::optional<std::string>& previousSelectedNetworkName() const {
        return previousSelectedNetworkName_;
    }

    // 14. Network list table -- network_list/table.cpp ------------------------------------------------------
    // All *Main*, but for the spinner.

    /// Runs the first scan in the background and shows the list; returns at once.
    void displayNetworkList();
    void setupRefreshControl();
    /// Marks a scan as under way, and as done. *Any* thread.
    void showSpinner();
    void hideSpinner();
    /// Whether rows can be selected.
    void enableTableViewSelection(bool enable);
    /// Deliberately nothing, both: the screen has no buttons in its bar, and the callers keep calling.
    void enableRightBarButtonItem(bool enable);
    void removeNavigationBarButtons();
    /// Works out anew whether the row that scans again takes touches.
    void reloadRefreshCell();
    void scrollToSelectedNetwork();
    void scrollToLastFocusedItem();
    /// One more than there are choosable networks.
    int networksOffset() const;

    int numberOfSectionsInTableView(ui::SettingsTableView& tableView) override;
    int tableViewNumberOfRowsInSection(ui::SettingsTableView& tableView, int section) override;
    std::optional<std::string> tableViewTitleForHeaderInSection(ui::SettingsTableView& tableView,
                                                                int section) override;
    std::shared_ptr<ui::TableViewCell> tableViewCellForRowAtIndexPath(ui::SettingsTableView& tableView,
                                                                      ui::IndexPath indexPath) override;
    double tableViewHeightForHeaderInSection(ui::SettingsTableView& tableView, int section) override;
    double tableViewHeightForFooterInSection(ui::SettingsTableView& tableView, int section) override;
    void tableViewDidSelectRowAtIndexPath(ui::SettingsTableView& tableView, ui::IndexPath indexPath) override;
    bool tableViewCanFocusRowAtIndexPath(ui::SettingsTableView& tableView, ui::IndexPath indexPath) override;
    std::optional<ui::IndexPath> indexPathForPreferredFocusedViewInTableView(
        ui::SettingsTableView& tableView) override;
    /// Attached to the top of the screen.
    static constexpr int kBarPositionTopAttached = 3;
    int positionForBar() const { return kBarPositionTopAttached; }

    // 15. Screen layout and views -- network_list/screen_layout.cpp -----------------------------------------
    // All *Main*. Null before the views are built.

    /// Builds the screen. The argument is not consulted: the table is always there.
    void setupViewWithNetworkList(bool withNetworkList);

    bool prefersStatusBarHidden() const override { return false; }
    bool shouldAutorotate() const override { return false; }
    unsigned supportedInterfaceOrientations() const override { return ui::kOrientationMaskPortrait; }
    ui::InterfaceOrientation preferredInterfaceOrientationForPresentation() const override {
        return ui::InterfaceOrientation::portrait;
    }
    void updateViewConstraints() override;
    std::string screenName() const override { return progressScreenVisible_ ? "progress" : "list"; }

    const std::shared_ptr<ui::SettingsTableView>& tableView() const { return tableView_; }
    const std::shared_ptr<ui::Label>& descriptionLabel() const { return descriptionLabel_; }
    const std::shared_ptr<ui::Label>& mainLabel() const { return mainLabel_; }
    const std::shared_ptr<ui::ProgressView>& progressView() const { return progressView_; }
    const std::shared_ptr<ui::Label>& navigationBarLabel() const { return navigationBarLabel_; }
    double tableViewWidth() const { return tableViewWidth_; }
    const ui::EdgeInsets& tableViewPadding() const { return tableViewPadding_; }
    const ui::EdgeInsets& tableViewContentInsets() const { return tableViewContentInsets_; }
    /// Declared for headers of the table; nothing assigns them, so what is told to their spinners shows
    /// nothing.
    const std::shared_ptr<WiFiHeaderView>& networksGroupHeaderView() const {
        return networksGroupHeaderView_;
    }
    const std::shared_ptr<WiFiHeaderView>& selectedNetworkHeaderView() const {
        return selectedNetworkHeaderView_;
    }
    /// Nothing assigns or reads the images: rows show only their text.
    const std::shared_ptr<ui::ImageView>& blueCheck() const { return blueCheck_; }
    const std::shared_ptr<ui::ImageView>& spacer() const { return spacer_; }

  private:
    /// The controller as a block keeps it.
    std::shared_ptr<WiFiProfileViewController> self();
    /// The controller as what it owns itself (the screen's actions, the power callback) refers to it.
    std::weak_ptr<WiFiProfileViewController> weakSelf();

    // 1. Life of a run
    /// What the test run does beyond the device's tests, and the code with which it ends.
    struct Scope {
        std::optional<std::string> selectedName;
        bool runsCurrent = false;
        bool runsSelected = false;
        int statusCode = 0;
    };
    std::optional<std::string> currentNetworkName() const;
    Scope determineScope() const;
    DictionaryPointer makeConfiguration(const Scope& scope) const;
    void performTestRun();

    Platform& platform_;
    std::shared_ptr<WiFiProfileInputs> inputs_;
    DictionaryPointer currentNetworkConfiguration_;
    DictionaryPointer freshScanConfiguration_;
    DictionaryPointer configuration_;
    Synchronized<WiFiStatusPointer> wifiStatus_;
    std::atomic<bool> testRunStarted_ = false;
    std::atomic<bool> ended_ = false;

    // 2. Wi-Fi power
    bool obtainDevice(WiFiManagerClient& manager);
    void logWiFiManagerError(std::string_view message) const;

    Synchronized<std::shared_ptr<WiFiManagerClient>> manager_;
    Synchronized<std::shared_ptr<WiFiDeviceClient>> device_;
    std::atomic<bool> wifiPoweredOn_ = false;

    // 3. Phases and result document
    static std::int32_t testCount(const Scope& scope);

    DictionaryPointer deviceData_;
    DictionaryPointer currentNetworkData_;
    DictionaryPointer selectedNetworkData_;

    // 4. Progress screen
    std::atomic<std::int32_t> completedTests_ = 0;
    std::atomic<std::int32_t> totalTests_ = 0;
    bool progressScreenVisible_ = false;

    // 5. Test invocation: its steps, which the rows and the tests that are more than a row are made of
    void runTest(const TestRow& row, Configuration configuration, Results resultsDictionary) const;
    /// Stores the verdict; null where there is no information to be read.
    DictionaryPointer infoOfTest(const TestRow& row, Configuration configuration,
                                 Results resultsDictionary) const;
    DiagnosticsTestResultPointer resultOfTest(const TestRow& row, Configuration configuration) const;
    DictionaryPointer infoOfResult(const TestRow& row, const DiagnosticsTestResult& result) const;
    void storeInfoValue(const TestRow& row, const Dictionary& info, Results resultsDictionary) const;
    /// The array or the record under the row's key; a value of another kind counts as missing.
    ArrayPointer infoArray(const TestRow& row, const Dictionary& info) const;
    template <class RecordType>
    std::shared_ptr<const RecordType> infoRecord(const TestRow& row, const Dictionary& info) const;
    void logTestFailure(const TestRow& row, const Error& error) const;
    void logNotFound(std::string_view name) const;

    // 6. Device configuration tests
    void runDeviceTest(const TestRow& row) const;

    // 7. Current-network tests: properties
    void runCaptivePortalTest(const TestRow& row, Configuration configuration,
                              Results resultsDictionary) const;
    DictionaryPointer preferredNetworkDictionary(const PreferredNetworkRecord& record) const;

    // 8. Current-network tests: connectivity
    void runPingTest(const TestRow& row, Configuration configuration, Results resultsDictionary) const;
    DictionaryPointer pingSummary(const PingStatistics& statistics) const;

    // 9. Current-network tests: channel, signal, scan
    void runCongestionTest(const TestRow& row, Configuration configuration, Results resultsDictionary) const;
    void runSignalTest(const TestRow& row, Configuration configuration, Results resultsDictionary) const;
    void runNoScanResultsTest(const TestRow& row, Configuration configuration, Results resultsDictionary);
    void runHiddenScanResultsTest(const TestRow& row, Configuration configuration,
                                  Results resultsDictionary) const;

    Synchronized<ArrayPointer> wifiScanResults_;

    // 11. Scan list model
    enum class Scan { first, again };
    std::shared_ptr<ScanJob> beginScanJob(Scan scan) const;
    void scanForJob(ScanJob& job);
    void rebuild(ScanJob& job) const;
    void exchangeInRescan(ScanJob& job) const;
    void publish(ScanJob& job);
    void showRescan(ScanJob& job);
    ScanList& mutableList();

    std::shared_ptr<ScanList> list_ = makeScanList();
    std::shared_ptr<ScanList> previousList_ = makeScanList();
    WiFiScanResultPointer currentNetwork_;
    std::atomic<bool> scanFinished_ = false;
    bool refreshEnabled_ = false;

    // 13. Selection, confirmation, other network
    void selectName(const std::optional<std::string>& name);
    void takeFromList(const WiFiScanResultPointer& network);
    void putBackPreviousNetwork();
    void inBatch(const std::function<void()>& changes);

    std::optional<std::string> previousSelectedNetworkName_;

    // 14. Network list table
    void adoptConnectedName(const std::optional<std::string>& connectedName);
    void showFirstList(ScanJob& job);
    std::string textOfRow(ui::IndexPath indexPath) const;
    bool rowTakesTouches(ui::IndexPath indexPath) const;

    // 15. Screen layout and views
    void buildTable(const std::shared_ptr<ui::View>& root);
    void buildContent(const std::shared_ptr<ui::View>& root);
    void buildNavigationBar(const std::shared_ptr<ui::View>& root);

    std::shared_ptr<ui::SettingsTableView> tableView_;
    std::shared_ptr<ui::Label> descriptionLabel_;
    std::shared_ptr<ui::Label> mainLabel_;
    std::shared_ptr<ui::ProgressView> progressView_;
    std::shared_ptr<ui::Label> navigationBarLabel_;
    std::shared_ptr<WiFiHeaderView> networksGroupHeaderView_;
    std::shared_ptr<WiFiHeaderView> selectedNetworkHeaderView_;
    std::shared_ptr<ui::ImageView> blueCheck_;
    std::shared_ptr<ui::ImageView> spacer_;
    double tableViewWidth_ = 0;
    ui::EdgeInsets tableViewPadding_;
    ui::EdgeInsets tableViewContentInsets_;
};

}  // namespace wp
