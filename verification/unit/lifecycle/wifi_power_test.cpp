#include <gtest/gtest.h>

#include "verification/unit/fakes/diagnostic_run.h"
#include "verification/unit/fakes/printing.h"

namespace wp {
namespace {

using fakes::DiagnosticRun;
using fakes::NetworkList;
using Calls = std::vector<std::string>;
using Lines = std::vector<fakes::RecordingLog::Line>;

struct ListRun : DiagnosticRun {
    ListRun() : DiagnosticRun(NetworkList::shown) {}

    bool hasScanned() { return !device.service.requests().empty(); }
    ui::AlertAction& action(std::size_t index) { return *device.screen.alert()->actions().at(index); }
    /// Chooses an action of the alert with the keys, as a viewer does.
    void choose(std::size_t index) {
        for (std::size_t i = 0; i < index; ++i) device.screen.press(ui::Key::right);
        device.screen.press(ui::Key::select);
    }
};

TEST(StartWithTheList, ObtainsTheManagerAndItsFirstDeviceOnTheMainRunLoop) {
    ListRun run;
    run.device.wifi.setDeviceNames({"wlan0", "wlan1"});

    run.controller->start();

    EXPECT_EQ(run.device.wifi.calls(),
              (Calls{"client of type 0", "scheduled", "type 0", "devices copied", "registered"}));
    EXPECT_EQ(run.device.wifi.runLoop(), &run.device.queues.main());
    EXPECT_EQ(run.device.wifi.callbackDevice(), "wlan0");
    EXPECT_EQ(run.device.wifi.devicesAlive(), 1);
    EXPECT_TRUE(run.controller->wifiPoweredOn());
}

TEST(StartWithTheList, TakesAnyPowerButZeroForOn) {
    ListRun run;
    run.device.wifi.setInitialPower(2);

    run.controller->start();

    EXPECT_TRUE(run.controller->wifiPoweredOn());
    EXPECT_EQ(run.device.screen.alert(), nullptr);
}

TEST(StartWithTheList, ScansBeforeAnyTestRuns) {
    ListRun run;

    run.controller->start();
    EXPECT_FALSE(run.controller->scanFinished());
    run.device.queues.runAll();

    EXPECT_EQ(run.device.service.requestedTestIDs(), std::vector{31});
    EXPECT_EQ(run.device.service.requests().front().configuration, run.controller->freshScanConfiguration());
    EXPECT_TRUE(run.controller->scanFinished());
    EXPECT_EQ(run.statusCode(), std::nullopt);
    EXPECT_FALSE(run.controller->progressScreenVisible());
}

TEST(StartWithTheList, BuildsTheScreenAlsoWhenTheRunHasEndedAlready) {
    ListRun run;
    run.device.wifi.setHasRadio(false);

    run.controller->start();

    EXPECT_NE(run.device.screen.table(), nullptr);
}

TEST(StartWithTheList, EndsWithoutARadioAndAsksForNoClient) {
    ListRun run;
    run.device.wifi.setHasRadio(false);

    run.runToEnd();

    EXPECT_EQ(run.statusCode(), -2);
    EXPECT_TRUE(run.controller->isFinished());
    EXPECT_EQ(run.device.wifi.calls(), Calls());
    EXPECT_EQ(run.device.log.lines(),
              (Lines{{0, "WiFiManagerClientCreate failed - unable to get Wi-Fi manager handle."}}));
    for (const char* name : {"device", "currentNetwork", "selectedNetwork"})
        EXPECT_EQ(run.section(name)->size(), 0U);
    EXPECT_FALSE(run.hasScanned());
}

TEST(StartWithTheList, EndsWhenNoClientCanBeHad) {
    ListRun run;
    run.device.wifi.setCreatesClients(false);

    run.runToEnd();

    EXPECT_EQ(run.statusCode(), -2);
    EXPECT_EQ(run.device.log.lines(),
              (Lines{{0, "WiFiManagerClientCreate failed - unable to get Wi-Fi manager handle."}}));
}

TEST(StartWithTheList, EndsWithoutADeviceAndReleasesTheManager) {
    ListRun run;
    run.device.wifi.setDeviceNames({});

    run.runToEnd();

    EXPECT_EQ(run.statusCode(), -3);
    EXPECT_EQ(run.device.log.lines(), (Lines{{0, "[ERROR] - Couldn't find a Wi-Fi device."}}));
    EXPECT_EQ(run.device.wifi.clientsAlive(), 0);
    EXPECT_FALSE(run.hasScanned());
}

TEST(StartWithTheList, LeavesNoLineWhileErrorsAreNotKept) {
    ListRun run;
    run.device.log.setErrorEnabled(false);
    run.device.wifi.setHasRadio(false);

    run.controller->start();

    EXPECT_EQ(run.device.log.lines(), Lines());
}

TEST(SetUpOfWiFi, SaysWhetherThereIsADevice) {
    ListRun with;
    EXPECT_TRUE(with.controller->setupWiFi());

    ListRun without;
    without.device.wifi.setDeviceNames({});
    EXPECT_FALSE(without.controller->setupWiFi());
}

TEST(WiFiOff, AsksTheUserToTurnWiFiOn) {
    ListRun run;
    run.device.wifi.setInitialPower(0);

    run.controller->start();

    std::shared_ptr<ui::AlertController> alert = run.device.screen.alert();
    ASSERT_NE(alert, nullptr);
    EXPECT_EQ(alert->title(), std::nullopt);
    EXPECT_EQ(alert->message(), "text of POWER_ON_WIFI");
    EXPECT_EQ(alert->style(), ui::AlertController::Style::alert);
    ASSERT_EQ(alert->actions().size(), 2U);
    EXPECT_EQ(run.action(0).title(), "text of NO");
    EXPECT_EQ(run.action(0).style(), ui::AlertAction::Style::standard);
    EXPECT_EQ(run.action(1).title(), "text of YES");
    EXPECT_EQ(run.action(1).style(), ui::AlertAction::Style::standard);
    EXPECT_EQ(alert->textFields().size(), 0U);
    EXPECT_FALSE(run.controller->wifiPoweredOn());
}

TEST(WiFiOff, SpeaksOfWLANWhereTheDeviceDoes) {
    ListRun run;
    run.device.capabilities.add("wapi");
    run.device.wifi.setInitialPower(0);

    run.controller->start();

    EXPECT_EQ(run.device.screen.alert()->message(), "text of POWER_ON_WLAN");
}

TEST(WiFiOff, ScansNothingWhileTheQuestionStands) {
    ListRun run;
    run.device.wifi.setInitialPower(0);

    run.runToEnd();

    EXPECT_FALSE(run.hasScanned());
    EXPECT_EQ(run.statusCode(), std::nullopt);
}

TEST(WiFiOff, EndsWhenTheUserDeclines) {
    ListRun run;
    run.device.wifi.setInitialPower(0);
    run.controller->start();

    run.choose(0);
    run.device.queues.runAll();

    EXPECT_EQ(run.statusCode(), -4);
    EXPECT_FALSE(run.hasScanned());
    EXPECT_EQ(run.device.wifi.power(), 0);
}

TEST(WiFiOff, ShowsTheListWhenTheUserAgreesAndTheWiFiComesUp) {
    ListRun run;
    run.device.wifi.setInitialPower(0);
    run.controller->start();

    run.choose(1);
    run.device.queues.runAll();

    EXPECT_EQ(run.device.wifi.calls().back(), "power 1");
    EXPECT_TRUE(run.controller->wifiPoweredOn());
    EXPECT_EQ(run.device.service.requestedTestIDs(), std::vector{31});
    EXPECT_EQ(run.statusCode(), std::nullopt);
}

TEST(WiFiOff, WaitsForTheNotificationAfterTheUserAgreed) {
    ListRun run;
    run.device.wifi.setInitialPower(0);
    run.device.wifi.setObeysSetPower(false);
    run.controller->start();

    run.choose(1);
    run.device.queues.runAll();

    EXPECT_FALSE(run.hasScanned());
    EXPECT_EQ(run.statusCode(), std::nullopt);
}

TEST(WiFiOff, EndsWhenAChangeTellsThatWiFiStayedOff) {
    ListRun run;
    run.device.wifi.setInitialPower(0);
    run.controller->start();

    run.device.wifi.turnPower(0);
    run.device.queues.runAll();

    EXPECT_EQ(run.statusCode(), -5);
}

TEST(WiFiOff, AgreeingWithoutAManagerDoesNothing) {
    ListRun run;
    run.controller->presentWiFiPoweredOffAlert();

    run.choose(1);
    run.device.queues.runAll();

    EXPECT_EQ(run.device.wifi.calls(), Calls());
    EXPECT_EQ(run.statusCode(), std::nullopt);
}

TEST(PowerChange, EndsTheRunWhenWiFiGoesOffWhileTheListIsShown) {
    ListRun run;
    run.runToEnd();

    run.device.wifi.turnPower(0);
    run.device.queues.runAll();

    EXPECT_EQ(run.statusCode(), -5);
    EXPECT_FALSE(run.controller->wifiPoweredOn());
    EXPECT_EQ(run.device.wifi.devicesAlive(), 0);
}

TEST(PowerChange, ScansAgainWhenWiFiComesOnAnew) {
    ListRun run;
    run.runToEnd();

    run.device.wifi.turnPower(1);
    run.device.queues.runMain();
    EXPECT_FALSE(run.controller->scanFinished());
    run.device.queues.runAll();

    EXPECT_EQ(run.device.service.requestedTestIDs(), (std::vector{31, 31}));
    EXPECT_TRUE(run.controller->scanFinished());
}

TEST(PowerChange, EndsARunWhoseTestsAreUnderWayOnceAndWithItsOwnCode) {
    ListRun run;
    run.device.service.setJoinedNetwork("Home");
    run.runToEnd();
    run.device.service.setRequestHandler([&](const DiagnosticsTestRequest& request) {
        if (request.testID != 16) return;
        run.device.wifi.turnPower(0);
        run.device.queues.runMain();
    });

    run.controller->runTests();
    run.device.queues.runAll();

    EXPECT_EQ(run.statusCode(), -5);
    // Two tests were done; what is cancelled writes nothing.
    EXPECT_EQ(run.section("device")->size(), 2U);
}

TEST(PowerChange, DoesNothingAfterTheEnd) {
    ListRun run;
    run.runToEnd();
    run.device.wifi.turnPower(1);
    run.controller->endTestWithStatusCode(-4);
    std::size_t requests = run.device.service.requests().size();

    run.device.queues.runAll();
    run.device.wifi.turnPower(0);
    run.controller->powerChanged();
    run.device.queues.runAll();

    EXPECT_EQ(run.statusCode(), -4);
    EXPECT_EQ(run.device.service.requests().size(), requests);
    EXPECT_TRUE(run.controller->scanFinished());
}

TEST(PowerChange, DoesNothingAfterTeardown) {
    ListRun run;
    run.runToEnd();
    run.device.wifi.turnPower(0);

    run.controller->teardown();
    run.device.queues.runAll();
    run.controller->powerChanged();
    run.device.queues.runAll();

    EXPECT_EQ(run.statusCode(), std::nullopt);
    EXPECT_EQ(run.device.service.requestedTestIDs(), std::vector{31});
}

TEST(PowerChange, DoesNotKeepTheControllerAlive) {
    ListRun run;
    std::weak_ptr<WiFiProfileViewController> weak = run.controller;
    run.runToEnd();

    run.device.screen.setRootViewController(nullptr);
    run.controller.reset();

    EXPECT_TRUE(weak.expired());
    EXPECT_EQ(run.device.wifi.devicesAlive(), 0);
}

}  // namespace
}  // namespace wp
