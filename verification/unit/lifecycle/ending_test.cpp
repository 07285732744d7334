#include <gtest/gtest.h>

#include "verification/unit/fakes/diagnostic_run.h"
#include "verification/unit/fakes/printing.h"

namespace wp {
namespace {

using fakes::DiagnosticRun;
using fakes::NetworkList;

TEST(Ending, HandsOverTheLiveSectionsUnderExactlyThreeKeys) {
    DiagnosticRun run;

    run.controller->endTestWithStatusCode(0);

    EXPECT_EQ(run.controller->result().data()->size(), 3U);
    EXPECT_EQ(run.section("device"), run.controller->deviceData());
    EXPECT_EQ(run.section("currentNetwork"), run.controller->currentNetworkData());
    EXPECT_EQ(run.section("selectedNetwork"), run.controller->selectedNetworkData());

    run.controller->deviceData()->setValue("later", 1);
    EXPECT_EQ(run.section("device")->value("later"), Value(1));
}

TEST(Ending, CancelsReleasesAndSealsBeforeItSaysThatTheRunIsOver) {
    DiagnosticRun run(NetworkList::shown);
    run.controller->start();
    int devicesAlive = -1, clientsAlive = -1, cancellations = -1;
    std::optional<std::int64_t> code;
    run.controller->setFinishedHandler([&] {
        devicesAlive = run.device.wifi.devicesAlive();
        clientsAlive = run.device.wifi.clientsAlive();
        cancellations = run.device.service.cancellations();
        code = run.statusCode();
    });

    run.controller->endTestWithStatusCode(-4);

    EXPECT_EQ(devicesAlive, 0);
    EXPECT_EQ(clientsAlive, 0);
    EXPECT_EQ(cancellations, 1);
    EXPECT_EQ(code, -4);
}

TEST(Ending, KeepsTheFirstCodeAndTellsTheHostOnce) {
    DiagnosticRun run;
    int finished = 0;
    run.controller->setFinishedHandler([&] { ++finished; });

    run.controller->endTestWithStatusCode(-5);
    DictionaryPointer document = run.controller->result().data();
    run.controller->endTestWithStatusCode(0);

    EXPECT_EQ(run.statusCode(), -5);
    EXPECT_EQ(run.controller->result().data(), document);
    EXPECT_EQ(finished, 1);
}

TEST(Ending, LetsNoKeyReachTheControllerAnyMore) {
    DiagnosticRun run;
    EXPECT_TRUE(run.controller->acceptsInput());

    run.controller->endTestWithStatusCode(0);

    EXPECT_FALSE(run.controller->acceptsInput());
}

TEST(Teardown, CancelsAndLeavesTheResultAlone) {
    DiagnosticRun run;

    run.controller->teardown();

    EXPECT_EQ(run.device.service.cancellations(), 1);
    EXPECT_EQ(run.statusCode(), std::nullopt);
    EXPECT_FALSE(run.controller->isFinished());
}

TEST(Teardown, ReleasesTheHandlesAndIsHarmlessWhenRepeated) {
    DiagnosticRun run(NetworkList::shown);
    run.controller->start();
    EXPECT_EQ(run.device.wifi.devicesAlive(), 1);

    run.controller->teardown();
    run.controller->teardown();

    EXPECT_EQ(run.device.wifi.devicesAlive(), 0);
    EXPECT_EQ(run.device.wifi.clientsAlive(), 0);
    EXPECT_FALSE(run.device.wifi.hasCallback());
}

TEST(Teardown, UnregistersThePowerCallbackBeforeItReleasesTheManager) {
    DiagnosticRun run(NetworkList::shown);
    run.controller->start();

    run.controller->teardown();

    std::vector<std::string> calls = run.device.wifi.calls();
    ASSERT_GE(calls.size(), 2U);
    EXPECT_EQ(calls[calls.size() - 2], "unregistered");
    EXPECT_EQ(calls.back(), "client released");
}

TEST(Teardown, InTheMiddleOfARunLetsTheRestOfItComeToNothing) {
    DiagnosticRun run(NetworkList::hidden, "Office");
    run.device.service.setJoinedNetwork("Home");
    run.device.service.setRequestHandler([&](const DiagnosticsTestRequest& request) {
        if (request.testID == 8) run.controller->teardown();
    });

    run.runToEnd();

    EXPECT_EQ(run.controller->deviceData()->size(), 11U);
    EXPECT_EQ(run.controller->currentNetworkData()->size(), 0U);
    EXPECT_EQ(run.controller->selectedNetworkData()->size(), 0U);
    EXPECT_EQ(run.controller->completedTests(), 56);
}

}  // namespace
}  // namespace wp
