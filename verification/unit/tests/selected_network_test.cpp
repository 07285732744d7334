#include "verification/unit/tests/catalogue_fixture.h"

namespace wp::rows {
namespace {

using fakes::DiagnosticRun;
using fakes::NetworkList;
using fakes::outcome;

struct SelectedRow {
    const char* name;
    DeviceOperation operation;
    int testID;
    const char* resultKey;
};

// clang-format off
const std::vector<SelectedRow> kSelectedRows = {
    {"LongBeaconInterval",     &Controller::runSelectedNetworkLongBeaconInterval,     34, "isBeaconIntervalLong"},
    {"NoSecurity",             &Controller::runSelectedNetworkNoSecurity,             38, "isUsingOpenSecurity"},
    {"LegacySecurityWEP",      &Controller::runSelectedNetworkLegacySecurityWEP,      39, "isUsingWEPSecurity"},
    {"LegacySecurityWPA",      &Controller::runSelectedNetworkLegacySecurityWPA,      40, "isUsingWPASecurity"},
    {"LegacyRates11b",         &Controller::runSelectedNetworkLegacyRates11b,         41, "isUsingLegacyRates"},
    {"AmbiguousNetworkName",   &Controller::runSelectedNetworkAmbiguousNetworkName,   42, "isUsingAmbiguousNetworkName"},
    {"HiddenNetwork",          &Controller::runSelectedNetworkHiddenNetwork,          43, "isHiddenNetwork"},
    {"PyloPersonalHotspot",    &Controller::runSelectedNetworkPyloPersonalHotspot,    44, "isPyloPersonalHotspot"},
    {"CaptivePortal",          &Controller::runSelectedNetworkCaptivePortal,          46, "isCaptive"},
    {"Passpoint",              &Controller::runSelectedNetworkPasspoint,              45, "isPasspointNetwork"},
    {"ConflictingPHYMode11AC", &Controller::runSelectedNetworkConflictingPHYMode11AC, 36, "hasConflictingPHYMode11AC"},
    {"ConflictingPHYMode11N",  &Controller::runSelectedNetworkConflictingPHYMode11N,  37, "hasConflictingPHYMode11N"},
    {"MarlixBaseStation",      &Controller::runSelectedNetworkMarlixBaseStation,      33, "isHostedByMarlixBaseStation"},
    {"CongestedChannel",       &Controller::runSelectedNetworkCongestedChannel,       24, "isChannelCongested"},
    {"ConflictingCountryCode", &Controller::runSelectedNetworkConflictingCountryCode, 28, "foundConflictingCountryCode"},
    {"PoorSignal",             &Controller::runSelectedNetworkPoorSignal,             32, "hasPoorSignal"},
};
// clang-format on

/// A run that has ended, joined to Home, with the selected name given.
struct EndedRun : DiagnosticRun {
    explicit EndedRun(const char* selected) : DiagnosticRun(NetworkList::hidden, selected) {
        device.service.setJoinedNetwork("Home");
        runToEnd();
    }
};

class SelectedRowTest : public ::testing::TestWithParam<SelectedRow> {};

TEST_P(SelectedRowTest, RunsTheNetworkTestOnTheSelectedNetworkAlone) {
    EndedRun run("Office");
    for (const auto& entry : run.controller->selectedNetworkData()->entries())
        run.controller->selectedNetworkData()->removeValue(entry.first);
    Dictionary::Entries current = run.controller->currentNetworkData()->entries();
    std::size_t before = run.device.service.requests().size();

    ((*run.controller).*GetParam().operation)();

    // The service is cancelled after the run, so only the request shows here.
    DiagnosticsTestRequest request = run.device.service.requests().back();
    EXPECT_EQ(run.device.service.requests().size(), before + 1);
    EXPECT_EQ(request.testID, GetParam().testID);
    EXPECT_EQ(request.configuration, run.controller->configuration());
    EXPECT_EQ(run.controller->currentNetworkData()->entries(), current);
}

TEST_P(SelectedRowTest, WritesItsVerdictIntoTheSelectedSection) {
    DiagnosticRun run;
    run.device.service.setOutcome(GetParam().testID, outcome(true, true, Dictionary::make()));

    ((*run.controller).*GetParam().operation)();

    EXPECT_EQ(run.controller->selectedNetworkData()->value(GetParam().resultKey), Value(true));
    EXPECT_EQ(run.controller->currentNetworkData()->size(), 0U);
}

INSTANTIATE_TEST_SUITE_P(EveryTest, SelectedRowTest, ::testing::ValuesIn(kSelectedRows),
                         [](const auto& test) { return test.param.name; });

TEST(SelectedNetwork, ReceivesTheCacheAgeAndTheNameWithEachOfItsSixteenTests) {
    EndedRun run("Office");

    std::vector<DiagnosticsTestRequest> requests = run.device.service.requests();
    ASSERT_EQ(requests.size(), 56U);
    for (std::size_t i = 40; i < 56; ++i) {
        EXPECT_EQ(requests[i].testID, kSelectedRows[i - 40].testID);
        EXPECT_EQ(requests[i].configuration->entries(),
                  (Dictionary::Entries{{"MaxScanCacheAge", 30u}, {"NetworkName", "Office"}}));
    }
}

TEST(SelectedNetwork, IsLeftEmptyWhenItIsTheCurrentOneOrAsksNotToBeMeasured) {
    for (const char* name : {"Home", "Cafe_nomap", "Cafe_NoMap", "_NOMAP"}) {
        EndedRun run(name);

        EXPECT_EQ(run.device.service.requests().size(), 40U) << name;
        EXPECT_EQ(run.section("selectedNetwork")->size(), 0U) << name;
    }
}

TEST(SelectedNetwork, LeavesOutTheKeysOfAFailedTestAndKeepsThoseOfTheCurrentNetwork) {
    DiagnosticRun run(NetworkList::hidden, "Office");
    run.device.service.setJoinedNetwork("Home");
    int poorSignalTests = 0;
    run.device.service.setRequestHandler([&](const DiagnosticsTestRequest& request) {
        if (request.testID == 32 && ++poorSignalTests == 2)
            run.device.service.setOutcome(32, fakes::failure(4, "out of range"));
    });

    run.runToEnd();

    EXPECT_EQ(run.section("currentNetwork")->value("hasPoorSignal"), Value(false));
    EXPECT_FALSE(run.section("selectedNetwork")->value("hasPoorSignal"));
    EXPECT_EQ(run.device.log.lines(3).back(),
              "[ERROR] - Wi-Fi Profile: Poor Signal failed with error: out of range (code 4)");
}

TEST(SelectedNetwork, NeverHoldsWhatOnlyTheCurrentNetworkCanTell) {
    EndedRun run("Office");

    for (const char* key : {"hasDoubleNATConfiguration", "isDTIMIntervalLong", "pingedLAN", "pingLANResult",
                            "pingedWAN", "pingWANResult", "isIPv4Assigned", "isIPv6Assigned", "resolvedDNS",
                            "reachedVantor", "retrievedVantor", "is2GHzCongested", "is5GHzCongested",
                            "hasHT40Channel", "foundHiddenNetworks", "foundScanResults"}) {
        EXPECT_FALSE(run.section("selectedNetwork")->value(key)) << key;
    }
    EXPECT_EQ(run.section("selectedNetwork")->size(), 16U);
}

}  // namespace
}  // namespace wp::rows
