#include <gtest/gtest.h>

#include "verification/unit/fakes/diagnostic_run.h"
#include "verification/unit/fakes/printing.h"

namespace wp {
namespace {

using fakes::DiagnosticRun;
using fakes::NetworkList;
using fakes::outcome;
using Entries = Dictionary::Entries;

const std::vector<int> kDeviceTestIDs = {14, 15, 16, 17, 22, 19, 18, 20, 47, 48, 29};
const std::vector<int> kCurrentNetworkTestIDs = {8, 34, 35, 38, 39, 40, 41, 42, 43, 44, 46, 45, 36, 37, 33,
                                                 3, 6,  12, 13, 7,  9,  11, 24, 25, 26, 27, 28, 32, 30};
const std::vector<int> kSelectedNetworkTestIDs = {34, 38, 39, 40, 41, 42, 43, 44,
                                                  46, 45, 36, 37, 33, 24, 28, 32};

TEST(Phases, RunTheDevicesElevenTestsInTheirOrder) {
    DiagnosticRun run;

    run.controller->runDeviceConfigurationDiagnosticsTests();

    EXPECT_EQ(run.device.service.requestedTestIDs(), kDeviceTestIDs);
    EXPECT_EQ(run.controller->completedTests(), 11);
}

TEST(Phases, RunTheCurrentNetworksTwentyNineTestsInTheirOrder) {
    DiagnosticRun run;

    run.controller->runCurrentNetworkDiagnosticsTests();

    EXPECT_EQ(run.device.service.requestedTestIDs(), kCurrentNetworkTestIDs);
    EXPECT_EQ(run.controller->completedTests(), 29);
    for (const DiagnosticsTestRequest& request : run.device.service.requests())
        EXPECT_EQ(request.configuration, run.controller->currentNetworkConfiguration());
    EXPECT_EQ(run.controller->selectedNetworkData()->size(), 0U);
}

TEST(Phases, RunTheSelectedNetworksSixteenTestsInTheirOrder) {
    DiagnosticRun run;

    run.controller->runSelectedNetworkDiagnosticsTests();

    EXPECT_EQ(run.device.service.requestedTestIDs(), kSelectedNetworkTestIDs);
    EXPECT_EQ(run.controller->completedTests(), 16);
    EXPECT_EQ(run.controller->currentNetworkData()->size(), 0U);
}

TEST(Phases, FollowOneAnotherEachWithItsConfiguration) {
    DiagnosticRun run(NetworkList::hidden, "Office");
    run.device.service.setJoinedNetwork("Home");

    run.runToEnd();

    std::vector<int> testIDs = kDeviceTestIDs;
    testIDs.insert(testIDs.end(), kCurrentNetworkTestIDs.begin(), kCurrentNetworkTestIDs.end());
    testIDs.insert(testIDs.end(), kSelectedNetworkTestIDs.begin(), kSelectedNetworkTestIDs.end());
    EXPECT_EQ(run.device.service.requestedTestIDs(), testIDs);
    std::vector<DiagnosticsTestRequest> requests = run.device.service.requests();
    for (std::size_t i = 0; i < requests.size(); ++i) {
        bool isCurrent = i >= 11 && i < 40;
        EXPECT_EQ(requests[i].configuration, isCurrent ? run.controller->currentNetworkConfiguration()
                                                       : run.controller->configuration());
    }
}

TEST(Phases, CountEachTestAfterItIsDone) {
    DiagnosticRun run(NetworkList::hidden, "Office");
    run.device.service.setJoinedNetwork("Home");
    std::vector<std::int32_t> counts;
    run.device.service.setRequestHandler(
        [&](const DiagnosticsTestRequest&) { counts.push_back(run.controller->completedTests()); });

    run.runToEnd();

    ASSERT_EQ(counts.size(), 56U);
    for (std::int32_t i = 0; i < 56; ++i) EXPECT_EQ(counts[static_cast<std::size_t>(i)], i);
    EXPECT_EQ(run.controller->completedTests(), run.controller->totalTests());
}

TEST(Phases, KnowTheirTotalBeforeTheFirstTest) {
    DiagnosticRun run(NetworkList::hidden, "Office");
    run.device.service.setJoinedNetwork("Home");
    std::optional<std::int32_t> total;
    run.device.service.setRequestHandler([&](const DiagnosticsTestRequest&) {
        if (!total) total = run.controller->totalTests();
    });

    run.runToEnd();

    EXPECT_EQ(total, 56);
}

TEST(Phases, NeverStopEarlyWhenEveryTestFails) {
    DiagnosticRun run(NetworkList::hidden, "Office");
    run.device.service.setJoinedNetwork("Home");
    run.device.service.setDefaultOutcome(fakes::failure(110, "timed out"));

    run.runToEnd();

    EXPECT_EQ(run.device.service.requests().size(), 56U);
    EXPECT_EQ(run.device.log.lines(3).size(), 56U);
    EXPECT_EQ(run.controller->completedTests(), 56);
    EXPECT_EQ(run.statusCode(), 0);
    for (const char* name : {"device", "currentNetwork", "selectedNetwork"})
        EXPECT_EQ(run.section(name)->size(), 0U);
}

TEST(Phases, LeaveTheScanForTheListOutOfTheCurrentNetworksTests) {
    DiagnosticRun run;

    run.controller->runCurrentNetworkDiagnosticsTests();

    EXPECT_FALSE(run.controller->currentNetworkData()->value("foundScanResults"));
    EXPECT_TRUE(run.controller->currentNetworkData()->value("foundHiddenNetworks"));
}

TEST(ResultDocument, KeepsWhatTheScanOfTheListWroteIntoTheCurrentSection) {
    DiagnosticRun run(NetworkList::shown);
    run.runToEnd();

    run.controller->runTests();
    run.device.queues.runAll();

    EXPECT_EQ(run.section("currentNetwork")->entries(), (Entries{{"foundScanResults", 1}}));
    EXPECT_EQ(run.statusCode(), 0);
}

TEST(ResultDocument, FormatsMomentsInUniversalTime) {
    DiagnosticRun run;

    EXPECT_EQ(run.controller->timestampFormattedInISO8601(Date{0}), "2001-01-01T00:00:00Z");
    EXPECT_EQ(run.controller->timestampFormattedInISO8601(Date{785'246'625.75}), "2025-11-19T12:03:45Z");
}

}  // namespace
}  // namespace wp
