#include "network_list/scan_list.h"

#include <gtest/gtest.h>

#include "verification/unit/network_list/list_run.h"

namespace wp {
namespace {

using namespace fakes;

WiFiStatusPointer joinedTo(std::optional<std::string> ssid, std::optional<std::string> bssid) {
    auto status = std::make_shared<WiFiStatus>();
    status->ssid = std::move(ssid);
    status->bssid = std::move(bssid);
    return status;
}

/// The choosable networks as "name strength".
std::vector<std::string> choosable(const ScanList& list) {
    std::vector<std::string> names;
    for (const auto& network : list.filteredWiFiScanResults)
        names.push_back(*network->ssid + " " + std::to_string(network->rssi));
    return names;
}

ScanList reduced(const std::vector<AccessPoint>& points, WiFiStatusPointer status = nullptr) {
    ScanList list;
    reduceScan(scanArray(points), status, list);
    return list;
}

TEST(ReducedScan, KeepsTheStrongestAccessPointOfAName) {
    EXPECT_EQ(choosable(reduced({{"Cafe", "a", -70}, {"Cafe", "b", -60}, {"Cafe", "c", -65}})),
              std::vector<std::string>{"Cafe -60"});
}

TEST(ReducedScan, KeepsTheFirstOfEquallyStrongAccessPoints) {
    ScanList list = reduced({{"Cafe", "first", -60}, {"Cafe", "second", -60}});

    ASSERT_EQ(list.filteredWiFiScanResults.size(), 1u);
    EXPECT_EQ(list.filteredWiFiScanResults[0]->bssid, "first");
    EXPECT_EQ(list.distinctNetworks.network("Cafe")->bssid, "first");
}

TEST(ReducedScan, LeavesHiddenNetworksOutButKeepsTheEmptyName) {
    EXPECT_EQ(choosable(reduced({{std::nullopt, "a", -30}, {"", "b", -40}})),
              std::vector<std::string>{" -40"});
}

TEST(ReducedScan, TellsNamesApartThatDifferOnlyInCase) {
    ScanList list = reduced({{"home", "a", -50}, {"Apple", "b", -50}, {"Home", "c", -50}, {"zoo", "d", -50}});

    list.sort(FakeLocalization());

    EXPECT_EQ(choosable(list), (std::vector<std::string>{"Apple -50", "home -50", "Home -50", "zoo -50"}));
}

TEST(ReducedScan, PutsTheJoinedAccessPointNowhereButIntoTheDistinctNetworks) {
    ScanList list;
    auto joined = reduceScan(scanArray({{"Home", "1", -40}, {"Home", "2", -30}, {"Cafe", "3", -50}}),
                             joinedTo("Home", "1"), list);

    ASSERT_NE(joined, nullptr);
    EXPECT_EQ(joined->bssid, "1");
    EXPECT_EQ(list.distinctNetworks.network("Home"), joined);
    EXPECT_EQ(choosable(list), std::vector<std::string>{"Cafe -50"});
}

TEST(ReducedScan, WithTheJoinedAccessPointUnheardHasItsNameNowhere) {
    ScanList list;
    auto joined = reduceScan(scanArray({{"Home", "2", -30}}), joinedTo("Home", "1"), list);

    EXPECT_EQ(joined, nullptr);
    EXPECT_EQ(list.distinctNetworks.size(), 0u);
    EXPECT_EQ(list.filteredNetworks.size(), 0u);
}

TEST(ReducedScan, WithoutAConnectionHasEveryNamedNetworkChoosable) {
    ScanList list;
    auto joined = reduceScan(scanArray({{"Home", std::nullopt, -40}, {"Cafe", "3", -50}}),
                             joinedTo(std::nullopt, std::nullopt), list);

    EXPECT_EQ(joined, nullptr);
    EXPECT_EQ(choosable(list), (std::vector<std::string>{"Home -40", "Cafe -50"}));
}

TEST(ReducedScan, OfNoScanIsEmptyAndReplacesWhatWasThere) {
    ScanList list = reduced({{"Cafe", "a", -60}});

    reduceScan(nullptr, nullptr, list);

    EXPECT_TRUE(choosable(list).empty());
    EXPECT_EQ(list.distinctNetworks.size(), 0u);
}

TEST(ReducedScan, PassesOverValuesThatAreNoScanResults) {
    auto mixed = std::make_shared<const Array>(Array{Value("text"), Value(), scanEntry({"Cafe", "a", -60})});
    ScanList list;

    reduceScan(mixed, nullptr, list);

    EXPECT_EQ(choosable(list), std::vector<std::string>{"Cafe -60"});
}

TEST(SortedList, KeepsNamesThatCollateAsEqualInTheOrderInWhichTheyWereFirstStored) {
    ScanList list = reduced({{"b", "1", -60},
                             {"HOME", "2", -80},
                             {"home", "3", -60},
                             {"Home", "4", -50},
                             {"HOME", "5", -40},
                             {"A", "6", -60}});

    list.sort(FakeLocalization());

    EXPECT_EQ(choosable(list),
              (std::vector<std::string>{"A -60", "b -60", "HOME -40", "home -60", "Home -50"}));
}

TEST(SortedList, AsksForTheCollationKeyOfEachNameOnce) {
    struct CountingLocalization final : Localization {
        mutable int asked = 0;
        std::string localizedString(std::string_view) const override { return {}; }
        std::string collationKey(std::string_view name) const override {
            ++asked;
            return std::string(name);
        }
    };
    CountingLocalization localization;
    ScanList list;
    for (int i = 0; i < 500; ++i) list.addNetwork(scanEntry({std::to_string(i * 7919 % 500), "b", -60}));

    list.sort(localization);
    list.sort(localization);
    ScanList next = reduced({{"3", "b", -60}, {"4", "b", -60}, {"new", "b", -60}});
    next.sort(localization, &list);

    EXPECT_EQ(localization.asked, 501);
}

TEST(ListOfNetworks, AddsAndRemovesNothingForNull) {
    ScanList list = reduced({{"Cafe", "a", -60}});

    list.addNetwork(nullptr);
    list.removeNetwork(nullptr);

    EXPECT_EQ(choosable(list), std::vector<std::string>{"Cafe -60"});
}

TEST(ListOfNetworks, RemovesEveryOccurrenceOfTheVeryEntryAndTheNameItself) {
    ScanList list = reduced({{"Cafe", "a", -60}});
    auto twin = scanEntry({"Cafe", "a", -60});
    list.addNetwork(twin);
    list.addNetwork(twin);

    list.removeNetwork(twin);

    EXPECT_EQ(choosable(list), std::vector<std::string>{"Cafe -60"});
    EXPECT_FALSE(list.filteredNetworks.contains("Cafe"));
}

}  // namespace
}  // namespace wp
