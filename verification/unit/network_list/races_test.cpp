// The list on real threads: whatever the order in which scan, test run, power and keys meet, nothing is lost,
// shown twice or torn, and the run ends once. Meant for the thread sanitizer; each story is told many times.

#include <gtest/gtest.h>

#include <atomic>
#include <set>
#include <thread>

#include "network_list/scan_list.h"
#include "verification/unit/network_list/list_run.h"

namespace wp {
namespace {

using namespace fakes;
using ui::Key;

constexpr int kTimes = 20;

/// A run with the list on real threads; the test's thread is the main thread.
struct ThreadedRun {
    explicit ThreadedRun(std::optional<std::string> name = std::nullopt)
        : controller(controllerFor(device.platform, request(NetworkList::shown, std::move(name)))) {
        device.activity.setIdleHandler([this] { device.main.wake(); });
        device.screen.setRootViewController(controller);
        device.service.setJoinedNetwork("Home", "1");
        hear({{"Home", "1"}, {"Cafe", "2"}, {"Zoo", "3"}});
    }
    ~ThreadedRun() {
        tearDown();
        device.activity.setIdleHandler(nullptr);
    }

    void hear(const std::vector<AccessPoint>& points) {
        device.service.setOutcome(kScanTest, scanOutcome(points));
    }
    /// Lets everything run that follows from what happened so far.
    void rest() {
        device.main.runUntil([this] { return device.activity.idle(); });
    }
    void tearDown() {
        controller->teardown();
        do {
            device.background.drain(BackgroundQueue::Delayed::drop);
            device.main.runPending();
        } while (!device.activity.idle());
    }
    void press(std::initializer_list<Key> keys) {
        for (Key key : keys) device.screen.press(key);
    }
    void choose(const std::string& text) {
        ui::SettingsTableView& table = *device.screen.table();
        for (int section = 0; section < table.numberOfSections(); ++section)
            for (int row = 0; row < table.numberOfRows(section); ++row)
                if (keyOf(table.cellForRow({row, section})->text()) == text) table.focusRow({row, section});
        device.screen.press(Key::select);
    }
    /// The names of the choosable networks as the table shows them.
    std::multiset<std::string> choosable() const {
        std::multiset<std::string> names;
        ui::SettingsTableView& table = *device.screen.table();
        for (int row = 0; row < table.numberOfRows(1); ++row)
            names.insert(table.cellForRow({row, 1})->text());
        return names;
    }
    int repairs() const { return controller->tableView()->repairs(); }

    ThreadedDevice device;
    std::shared_ptr<WiFiProfileViewController> controller;
};

using Names = std::multiset<std::string>;

TEST(ListOnThreads, OfAScanThatAnswersAtOnceIsShownOnceAndWhole) {
    for (int time = 0; time < kTimes; ++time) {
        ThreadedRun run;
        run.controller->start();
        if (time % 2)
            run.device.background.drain(BackgroundQueue::Delayed::keep);  // all of it before any row
        run.rest();

        EXPECT_EQ(run.choosable(), (Names{"Cafe", "Zoo"}));
        EXPECT_EQ(run.repairs(), 0);
    }
}

TEST(ListOnThreads, IsDrawnAndWalkedThroughWhileASlowScanRebuildsIt) {
    for (int time = 0; time < kTimes; ++time) {
        ThreadedRun run;
        run.controller->start();
        run.rest();
        run.hear({{"Home", "1"}, {"Cafe", "2"}, {"New", "4"}});

        run.device.service.holdRequests();
        run.choose("REFRESH");
        run.device.service.waitForRequests(2);
        run.press({Key::up, Key::up, Key::select, Key::up});
        EXPECT_EQ(run.choosable(), (Names{"Cafe", "Zoo"}));
        run.device.service.letRequestsGo();
        while (!run.device.activity.idle()) {
            run.press({Key::down, Key::up});
            run.device.screen.layoutIfNeeded();
            run.device.main.runPending();
        }

        EXPECT_EQ(run.choosable(), (Names{"Cafe", "New"}));
        EXPECT_EQ(run.repairs(), 0);
    }
}

TEST(ListOnThreads, ConfirmedDuringItsFirstScanRunsTheTestsBesideIt) {
    for (int time = 0; time < 4; ++time) {
        ThreadedRun run("Cafe");
        run.device.service.holdRequests();
        run.controller->start();
        run.device.service.waitForRequests(1);
        run.device.main.runPending();

        run.choose("Cafe");
        run.press({Key::select});
        run.device.service.waitForRequests(2);
        run.device.service.letRequestsGo();
        run.rest();

        EXPECT_EQ(run.controller->result().statusCode(), 0);
        EXPECT_EQ(run.controller->completedTests(), 56);
        EXPECT_EQ(run.controller->currentNetworkData()->value("foundScanResults"), Value(1));
        EXPECT_EQ(run.choosable(), (Names{"Home", "Zoo"}));
        EXPECT_EQ(run.repairs(), 0);
    }
}

TEST(ListOnThreads, OfANameTypedDuringTheFirstStatusQueryIsThatNames) {
    for (int time = 0; time < kTimes; ++time) {
        ThreadedRun run;
        std::atomic<bool> isAsked = false;
        std::atomic<bool> mayAnswer = false;
        run.device.service.setStatusHandler([&] {
            isAsked = true;
            while (!mayAnswer) std::this_thread::yield();
        });
        run.controller->start();
        while (!isAsked) std::this_thread::yield();

        run.choose("OTHER");
        run.device.screen.typeText("Zoo");
        run.press({Key::down, Key::down});
        if (time % 2) mayAnswer = true;
        run.press({Key::select});
        mayAnswer = true;
        run.rest();

        EXPECT_EQ(run.controller->inputs()->selectedNetworkName(), "Zoo");
        EXPECT_EQ(run.choosable(), (Names{"Cafe", "Home"}));
        EXPECT_EQ(run.repairs(), 0);
    }
}

TEST(PowerOnThreads, OffWhileListingEndsTheRunOnce) {
    for (int time = 0; time < kTimes; ++time) {
        ThreadedRun run;
        run.controller->start();
        run.rest();

        run.device.wifi.turnPower(0);
        run.device.wifi.turnPower(1);
        run.device.wifi.turnPower(0);
        run.rest();

        EXPECT_EQ(run.controller->result().statusCode(), -5);
        std::string before = picture(run.device.screen);
        run.press({Key::down, Key::select, Key::back});
        EXPECT_EQ(picture(run.device.screen), before);
    }
}

TEST(PowerOnThreads, OffWhileScanningCancelsTheScanAndEndsTheRun) {
    for (int time = 0; time < kTimes; ++time) {
        ThreadedRun run;
        run.device.service.holdRequests();
        run.controller->start();
        run.device.service.waitForRequests(1);

        run.device.wifi.turnPower(0);
        run.rest();

        EXPECT_EQ(run.controller->result().statusCode(), -5);
        EXPECT_EQ(run.choosable(), Names{});
    }
}

TEST(PowerOnThreads, OnAgainAndAgainWhileScanningLosesAndDoublesNothing) {
    for (int time = 0; time < kTimes; ++time) {
        ThreadedRun run;
        run.device.service.holdRequests();
        run.controller->start();
        run.device.wifi.turnPower(1);
        run.device.wifi.turnPower(1);
        run.device.main.runPending();
        run.device.service.waitForRequests(3);
        run.device.service.letRequestsGo();
        run.rest();

        EXPECT_EQ(run.choosable(), (Names{"Cafe", "Zoo"}));
        EXPECT_LE(run.repairs(), 2);
    }
}

TEST(PowerOnThreads, OnAgainDuringARescanLosesAndDoublesNothing) {
    for (int time = 0; time < kTimes; ++time) {
        ThreadedRun run;
        run.controller->start();
        run.rest();
        run.hear({{"Home", "1"}, {"Cafe", "2"}, {"New", "4"}});

        run.choose("REFRESH");
        run.device.wifi.turnPower(1);
        run.rest();

        EXPECT_EQ(run.choosable(), (Names{"Cafe", "New"}));
        EXPECT_LE(run.repairs(), 1);
        EXPECT_TRUE(run.controller->tableView()->allowsSelection());
    }
}

TEST(PowerOnThreads, OnAgainWhileAConfirmationIsOpenLeavesItOpenAndItsYesGood) {
    for (int time = 0; time < 4; ++time) {
        ThreadedRun run;
        run.controller->start();
        run.rest();
        run.choose("Cafe");

        run.hear({{"Home", "1"}, {"Zoo", "3"}});
        run.device.wifi.turnPower(1);
        bool isListedFirst = time % 2;
        if (isListedFirst) run.rest();
        EXPECT_NE(run.device.screen.alert(), nullptr);
        run.press({Key::select});
        run.rest();

        EXPECT_EQ(run.controller->result().statusCode(), 0);
        EXPECT_EQ(run.controller->inputs()->selectedNetworkName(), "Cafe");
        // A list that is built for a selected name that is not heard leaves the joined network out.
        EXPECT_EQ(run.choosable(), isListedFirst ? (Names{"Home", "Zoo"}) : Names{"Zoo"});
        EXPECT_LE(run.repairs(), 1);
    }
}

TEST(PowerOnThreads, OffWhileAConfirmationIsOpenTakesItsKeysAway) {
    for (int time = 0; time < kTimes; ++time) {
        ThreadedRun run;
        run.controller->start();
        run.rest();
        run.choose("Cafe");

        run.device.wifi.turnPower(0);
        run.rest();
        run.press({Key::select});
        run.rest();

        EXPECT_EQ(run.controller->result().statusCode(), -5);
        EXPECT_NE(run.device.screen.alert(), nullptr);
        EXPECT_FALSE(run.controller->progressScreenVisible());
    }
}

TEST(PowerOnThreads, OffWhileTestingEndsTheRunWithTheFirstCodeOnly) {
    for (int time = 0; time < kTimes; ++time) {
        ThreadedRun run;
        run.controller->start();
        run.rest();
        run.choose("Home");
        run.press({Key::select});
        run.device.service.waitForRequests(static_cast<std::size_t>(2 + time));

        run.device.wifi.turnPower(0);
        run.device.main.runUntil([&] { return run.controller->isFinished(); });
        run.tearDown();

        EXPECT_EQ(run.controller->result().statusCode(), -5);
    }
}

TEST(PowerOnThreads, OnWhileTestingScansBesideTheTests) {
    ThreadedRun run;
    run.controller->start();
    run.rest();
    run.choose("Cafe");
    run.press({Key::select});
    run.device.service.waitForRequests(5);

    run.device.wifi.turnPower(1);
    run.rest();

    EXPECT_EQ(run.controller->result().statusCode(), 0);
    EXPECT_EQ(run.choosable(), (Names{"Home", "Zoo"}));
}

TEST(PowerOnThreads, OffAtTheStartAsksAndYesBringsTheList) {
    for (int time = 0; time < kTimes; ++time) {
        ThreadedRun run;
        run.device.wifi.setInitialPower(0);
        run.controller->start();
        EXPECT_EQ(run.choosable(), Names{});

        run.press({Key::down, Key::select});
        run.rest();

        EXPECT_EQ(run.choosable(), (Names{"Cafe", "Zoo"}));
        EXPECT_EQ(run.repairs(), 0);
    }
}

TEST(TeardownOnThreads, InTheMiddleOfAnythingLeavesNothingRunning) {
    for (int time = 0; time < 4 * kTimes; ++time) {
        ThreadedRun run;
        if (time % 3 == 0) run.device.service.holdRequests();
        run.controller->start();
        if (time % 4 > 0) run.device.main.runPending();
        if (time % 4 == 2) run.device.wifi.turnPower(1);
        if (time % 4 == 3) {
            run.choose("Home");
            run.press({Key::select});
        }

        run.tearDown();

        EXPECT_TRUE(run.device.activity.idle());
        EXPECT_EQ(run.device.wifi.clientsAlive(), 0);
        EXPECT_FALSE(run.device.wifi.hasCallback());
    }
}

}  // namespace
}  // namespace wp
