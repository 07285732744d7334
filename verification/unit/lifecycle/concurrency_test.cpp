#include <gtest/gtest.h>

#include <thread>

#include "verification/unit/fakes/diagnostic_run.h"
#include "verification/unit/fakes/printing.h"

// Runs with real threads: what must hold whatever their order is. They say little by themselves and are here for
// the sanitizers.

namespace wp {
namespace {

using fakes::NetworkList;
using fakes::ThreadedDevice;

class ConcurrentRun : public ::testing::Test {
  protected:
    void setUp(NetworkList list) {
        device.service.setJoinedNetwork("Home", "02:00:00:00:00:01");
        controller = fakes::controllerFor(device.platform, fakes::request(list, "Office"));
        controller->setFinishedHandler([this] { device.main.wake(); });
        device.screen.setRootViewController(controller);
    }

    void waitUntilFinished() {
        device.main.runUntil([this] { return controller->isFinished(); });
    }

    /// What the host does before it reads the document or leaves.
    void drain() {
        controller->teardown();
        device.background.drain(BackgroundQueue::Delayed::drop);
        device.main.runPending();
        device.background.drain(BackgroundQueue::Delayed::drop);
    }

    std::size_t documentSize() {
        std::size_t size = 0;
        for (const auto& [name, section] : controller->result().data()->entries())
            size += (*section.as<DictionaryPointer>())->size();
        return size;
    }

    ThreadedDevice device;
    std::shared_ptr<WiFiProfileViewController> controller;
};

TEST_F(ConcurrentRun, GoesFromStartToEnd) {
    setUp(NetworkList::hidden);

    controller->start();
    waitUntilFinished();
    drain();

    EXPECT_EQ(controller->result().statusCode(), 0);
    EXPECT_EQ(controller->completedTests(), 56);
    EXPECT_EQ(documentSize(), 56U);
}

TEST_F(ConcurrentRun, LetsTheMainThreadReadWhatTheTestsWrite) {
    setUp(NetworkList::hidden);
    controller->start();

    std::int32_t seen = 0;
    while (seen < 56) {
        std::int32_t completed = controller->completedTests();
        EXPECT_GE(completed, seen);
        seen = completed;
        EXPECT_TRUE(controller->totalTests() == 0 || controller->totalTests() == 56);
        EXPECT_EQ(controller->inputs()->selectedNetworkName(), "Office");
        EXPECT_EQ(controller->wifiStatus()->ssid, "Home");
        EXPECT_LE(controller->currentNetworkData()->size(), 29U);
        device.main.runPending();
    }
    drain();
}

TEST_F(ConcurrentRun, EndsOnceWhenPowerGoesOffWhileTestsRun) {
    setUp(NetworkList::shown);
    controller->start();
    device.main.runUntil([this] { return controller->scanFinished(); });
    std::size_t scans = device.service.requests().size();
    device.service.holdRequests();
    controller->runTests();
    device.service.waitForRequests(scans + 1);

    device.wifi.turnPower(0);
    waitUntilFinished();
    drain();

    EXPECT_EQ(controller->result().statusCode(), -5);
    EXPECT_EQ(controller->deviceData()->size(), 0U);
    EXPECT_EQ(device.wifi.devicesAlive(), 0);
}

TEST_F(ConcurrentRun, EndsWithOneOfTwoCodesWhenTwoThreadsEndIt) {
    setUp(NetworkList::hidden);

    std::thread other([this] { controller->endTestWithStatusCode(-5); });
    controller->endTestWithStatusCode(0);
    other.join();

    std::optional<std::int64_t> code = controller->result().statusCode();
    EXPECT_TRUE(code == 0 || code == -5);
    EXPECT_TRUE(controller->isFinished());
}

TEST_F(ConcurrentRun, SurvivesATeardownInTheMiddleOfATest) {
    setUp(NetworkList::hidden);
    device.service.holdRequests();
    controller->start();
    device.service.waitForRequests(1);

    drain();

    EXPECT_EQ(controller->deviceData()->size(), 0U);
    EXPECT_EQ(controller->completedTests(), 56);
    EXPECT_FALSE(controller->isFinished());
}

TEST_F(ConcurrentRun, RunsTheTestsOnceWhenTheNetworkIsConfirmedTwice) {
    setUp(NetworkList::shown);
    controller->start();
    device.main.runUntil([this] { return controller->scanFinished(); });
    std::size_t scans = device.service.requests().size();

    controller->runTests();
    controller->runTests();
    waitUntilFinished();
    drain();

    EXPECT_EQ(device.service.requests().size(), scans + 56);
    EXPECT_EQ(controller->completedTests(), 56);
}

TEST_F(ConcurrentRun, MayBeConfirmedWhileTheFirstScanRuns) {
    setUp(NetworkList::shown);
    device.service.holdRequests();
    controller->start();
    device.service.waitForRequests(1);

    controller->runTests();
    device.service.waitForRequests(2);
    device.service.letRequestsGo();
    waitUntilFinished();
    drain();

    EXPECT_EQ(controller->result().statusCode(), 0);
    EXPECT_EQ(controller->currentNetworkData()->size(), 30U);
}

TEST_F(ConcurrentRun, TakesPowerThatComesAndGoesAtAnyTime) {
    setUp(NetworkList::shown);
    controller->start();
    controller->runTests();

    std::thread remote([this] {
        for (int i = 0; i < 20; ++i) device.wifi.turnPower(1);
        device.wifi.turnPower(0);
    });
    waitUntilFinished();
    remote.join();
    drain();

    // The tests end half a second after their last one at the earliest, or with the power.
    std::optional<std::int64_t> code = controller->result().statusCode();
    EXPECT_TRUE(code == 0 || code == -5);
}

}  // namespace
}  // namespace wp
