#include <gtest/gtest.h>

#include "verification/unit/fakes/diagnostic_run.h"
#include "verification/unit/fakes/printing.h"

namespace wp {
namespace {

using namespace std::chrono_literals;
using fakes::DiagnosticRun;
using fakes::NetworkList;
using Entries = Dictionary::Entries;

/// A run without the list that has ended.
struct EndedRun : DiagnosticRun {
    EndedRun(std::optional<std::string> joined, std::optional<std::string> named)
        : DiagnosticRun(NetworkList::hidden, std::move(named)) {
        device.service.setJoinedNetwork(std::move(joined));
        runToEnd();
    }
};

TEST(StartWithoutTheList, TestsTheDeviceAloneWhenNoNetworkIsJoinedOrNamed) {
    EndedRun run(std::nullopt, std::nullopt);

    EXPECT_EQ(run.controller->totalTests(), 11);
    EXPECT_EQ(run.device.service.requests().size(), 11U);
    EXPECT_EQ(run.statusCode(), 0);
    EXPECT_EQ(run.section("device")->size(), 11U);
    EXPECT_EQ(run.section("currentNetwork")->size(), 0U);
    EXPECT_EQ(run.section("selectedNetwork")->size(), 0U);
    EXPECT_EQ(run.controller->inputs()->selectedNetworkName(), std::nullopt);
}

TEST(StartWithoutTheList, TakesTheJoinedNetworkForTheSelectedOneWhenNoneIsNamed) {
    EndedRun run("Home", std::nullopt);

    EXPECT_EQ(run.controller->inputs()->selectedNetworkName(), "Home");
    EXPECT_EQ(run.controller->totalTests(), 40);
    EXPECT_EQ(run.device.service.requests().size(), 40U);
    EXPECT_EQ(run.section("selectedNetwork")->size(), 0U);
    EXPECT_EQ(run.statusCode(), 0);
}

TEST(StartWithoutTheList, TestsAnotherNetworkThatIsNamedToo) {
    EndedRun run("Home", "Office");

    EXPECT_EQ(run.controller->totalTests(), 56);
    EXPECT_EQ(run.device.service.requests().size(), 56U);
    EXPECT_EQ(run.controller->configuration()->entries(),
              (Entries{{"MaxScanCacheAge", 30u}, {"NetworkName", "Office"}}));
    EXPECT_EQ(run.statusCode(), 0);
}

TEST(StartWithoutTheList, TestsTheNamedNetworkAlsoWhenNoneIsJoined) {
    EndedRun run(std::nullopt, "Office");

    EXPECT_EQ(run.controller->totalTests(), 27);
    EXPECT_EQ(run.device.service.requests().size(), 27U);
    EXPECT_EQ(run.section("currentNetwork")->size(), 0U);
    EXPECT_EQ(run.section("selectedNetwork")->size(), 16U);
    EXPECT_EQ(run.statusCode(), 0);
}

TEST(StartWithoutTheList, TellsNamesApartByLetterCase) {
    EndedRun run("Home", "home");

    EXPECT_EQ(run.controller->totalTests(), 56);
    EXPECT_EQ(run.device.service.requests().size(), 56U);
}

TEST(StartWithoutTheList, TakesAnEmptyNameForAName) {
    EndedRun run("Home", "");

    EXPECT_EQ(run.controller->totalTests(), 56);
    EXPECT_EQ(run.controller->configuration()->value("NetworkName"), Value(""));
}

TEST(StartWithoutTheList, SkipsACurrentNetworkThatAsksNotToBeMeasured) {
    EndedRun run("Cafe_NoMap", std::nullopt);

    EXPECT_EQ(run.controller->totalTests(), 11);
    EXPECT_EQ(run.section("device")->size(), 11U);
    EXPECT_EQ(run.section("currentNetwork")->size(), 0U);
    // The selected name was taken from it, so the code of the selected network wins.
    EXPECT_EQ(run.statusCode(), -7);
}

TEST(StartWithoutTheList, TestsANamedNetworkBesideACurrentOneThatAsksNotToBeMeasured) {
    EndedRun run("Cafe_NoMap", "Office");

    EXPECT_EQ(run.controller->totalTests(), 27);
    EXPECT_EQ(run.device.service.requests().size(), 27U);
    EXPECT_EQ(run.statusCode(), -6);
}

TEST(StartWithoutTheList, SkipsASelectedNetworkThatAsksNotToBeMeasured) {
    EndedRun run("Home", "Office_NOMAP");

    EXPECT_EQ(run.controller->totalTests(), 40);
    EXPECT_EQ(run.device.service.requests().size(), 40U);
    EXPECT_EQ(run.statusCode(), -7);
}

TEST(StartWithoutTheList, LetsTheSelectedNetworksWishWinWhenBothAskNotToBeMeasured) {
    EndedRun run("Home_nomap", "Office_NOMAP");

    EXPECT_EQ(run.controller->totalTests(), 11);
    EXPECT_EQ(run.statusCode(), -7);
}

TEST(StartWithoutTheList, UsesTheVeryCurrentConfigurationWhenNothingIsSelected) {
    EndedRun run(std::nullopt, std::nullopt);

    EXPECT_EQ(run.controller->configuration(), run.controller->currentNetworkConfiguration());
    for (const DiagnosticsTestRequest& request : run.device.service.requests())
        EXPECT_EQ(request.configuration, run.controller->currentNetworkConfiguration());
}

TEST(StartWithoutTheList, AsksForTheCurrentNetworkOnceAndNeverForTheWiFiManager) {
    EndedRun run("Home", "Office");

    EXPECT_EQ(run.device.service.statusQueries(), 1);
    EXPECT_TRUE(run.device.wifi.calls().empty());
}

TEST(StartWithoutTheList, ShowsTheProgressBeforeTheViewsExistAndTestsInTheBackground) {
    DiagnosticRun run;
    bool wasShown = true;
    run.device.service.setStatusHandler([&] { wasShown = run.controller->progressScreenVisible(); });

    run.controller->start();

    EXPECT_FALSE(wasShown);
    EXPECT_TRUE(run.controller->progressScreenVisible());
    EXPECT_NE(run.device.screen.table(), nullptr);
    EXPECT_EQ(run.device.queues.readyInBackground(), 1U);
    EXPECT_EQ(run.device.service.requests().size(), 0U);
}

TEST(StartWithoutTheList, EndsHalfASecondAfterTheLastTest) {
    DiagnosticRun run;
    run.controller->start();
    run.device.queues.runReady();
    EXPECT_EQ(run.controller->completedTests(), 11);

    run.device.queues.advance(499ms);
    EXPECT_EQ(run.statusCode(), std::nullopt);
    EXPECT_FALSE(run.controller->isFinished());

    run.device.queues.advance(1ms);
    EXPECT_EQ(run.statusCode(), 0);
    EXPECT_TRUE(run.controller->isFinished());
}

TEST(StartWithoutTheList, GoesOnWithoutACurrentNetworkWhenTheStatusQueryFails) {
    DiagnosticRun run;
    run.device.service.setStatus({nullptr, Error{19, "no such device"}});

    run.runToEnd();

    EXPECT_EQ(run.device.log.lines(3).front(),
              "[ERROR] - Wi-Fi Profile: Query Status failed with error: no such device (code 19)");
    EXPECT_EQ(run.controller->totalTests(), 11);
    EXPECT_EQ(run.statusCode(), 0);
}

TEST(CurrentNetwork, StaysAsItWasWhenTheStatusQueryFails) {
    DiagnosticRun run;
    run.device.service.setJoinedNetwork("Home");
    run.controller->determineCurrentNetwork();
    WiFiStatusPointer before = run.controller->wifiStatus();
    run.device.service.setStatus({std::make_shared<const WiFiStatus>(), Error{5, "busy"}});

    run.controller->determineCurrentNetwork();

    EXPECT_EQ(run.controller->wifiStatus(), before);
}

TEST(CurrentNetwork, IsTakenFromAnAnswerWhoseErrorHasCodeZero) {
    DiagnosticRun run;
    auto status = std::make_shared<WiFiStatus>();
    run.device.service.setStatus({status, Error{0, "fine"}});

    run.controller->determineCurrentNetwork();

    EXPECT_EQ(run.controller->wifiStatus(), status);
    EXPECT_TRUE(run.device.log.lines().empty());
}

TEST(CurrentNetwork, BecomesAbsentWithAnAnswerWithoutAStatus) {
    DiagnosticRun run;
    run.device.service.setJoinedNetwork("Home");
    run.controller->determineCurrentNetwork();
    run.device.service.setStatus({nullptr, std::nullopt});

    run.controller->determineCurrentNetwork();

    EXPECT_EQ(run.controller->wifiStatus(), nullptr);
    EXPECT_TRUE(run.device.log.lines().empty());
}

TEST(CurrentNetwork, LeavesNoLineWhileErrorsAreNotKept) {
    DiagnosticRun run;
    run.device.log.setErrorEnabled(false);
    run.device.service.setStatus({nullptr, Error{5, "busy"}});

    run.controller->determineCurrentNetwork();

    EXPECT_TRUE(run.device.log.lines().empty());
}

TEST(RunTests, RunsOnceHoweverOftenItIsAskedTo) {
    DiagnosticRun run;

    run.controller->runTests();
    run.controller->runTests();
    run.device.queues.runReady();
    run.controller->nextTapped(nullptr);
    run.device.queues.runAll();
    run.controller->runTests();
    run.device.queues.runAll();

    EXPECT_EQ(run.device.service.requests().size(), 11U);
    EXPECT_EQ(run.controller->completedTests(), 11);
}

TEST(RunTests, DoesNothingOnceTheRunIsOver) {
    DiagnosticRun run;
    run.controller->endTestWithStatusCode(-4);

    run.controller->runTests();
    run.device.queues.runAll();

    EXPECT_FALSE(run.controller->progressScreenVisible());
    EXPECT_EQ(run.device.service.requests().size(), 0U);
}

TEST(RunTests, IsWhatTheNextButtonDoes) {
    DiagnosticRun run;

    run.controller->nextTapped(nullptr);
    run.device.queues.runAll();

    EXPECT_EQ(run.controller->totalTests(), 11);
    EXPECT_EQ(run.statusCode(), 0);
}

TEST(RunTests, DecidesInTheBackgroundWithTheNamesOfThatMoment) {
    DiagnosticRun run;
    run.device.service.setJoinedNetwork("Home");
    run.controller->determineCurrentNetwork();
    run.controller->runTests();

    run.controller->inputs()->setSelectedNetworkName("Office");
    run.device.queues.runAll();

    EXPECT_EQ(run.controller->totalTests(), 56);
}

TEST(RunTests, KeepsTheControllerAliveUntilItsBlocksAreDone) {
    DiagnosticRun run;
    std::weak_ptr<WiFiProfileViewController> weak = run.controller;
    run.controller->start();
    run.device.screen.setRootViewController(nullptr);
    run.controller.reset();

    run.device.queues.runReady();
    EXPECT_EQ(run.device.service.requests().size(), 11U);
    EXPECT_FALSE(weak.expired());

    run.device.queues.runAll();
    EXPECT_TRUE(weak.expired());
}

}  // namespace
}  // namespace wp
