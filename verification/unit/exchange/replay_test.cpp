#include "exchange/replay.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>

#include "platform/activity.h"
#include "platform/records.h"
#include "verification/unit/exchange/recordings.h"

namespace wp {
namespace {

using std::chrono::milliseconds;
using Clock = std::chrono::steady_clock;

RecordingPointer load(const std::string& name) {
    return std::make_shared<const Recording>(accepted(loadRecording(kFolder + name)));
}

DiagnosticsTestResponse ask(DiagnosticsClient& client, int test, DictionaryPointer dictionary = nullptr) {
    return client.runTestRequests({{test, std::move(dictionary)}});
}

/// The mark that the recordings of these tests put into each answer; the error's text where there is none.
std::string entry(DiagnosticsClient& client, int test, DictionaryPointer dictionary = nullptr) {
    DiagnosticsTestResponse response = ask(client, test, std::move(dictionary));
    if (response.error) return response.error->text();
    std::optional<Value> mark = response.results->front()->info->value("entry");
    return *mark->as<std::string>();
}

TEST(Replay, GivesTheNthStatusToTheNthQueryAndTheLastToAllLaterOnes) {
    ReplayDiagnosticsClient client(load("every_form.json"));

    EXPECT_EQ(client.queryStatus().status->ssid, "Northlight");
    EXPECT_FALSE(client.queryStatus().status->ssid);
    EXPECT_EQ(client.queryStatus().error->text(), "no interface (code 1)");
    EXPECT_EQ(client.queryStatus().error->text(), "no interface (code 1)");
}

TEST(Replay, IsNotConnectedWithoutAStatus) {
    ReplayDiagnosticsClient client(load("smallest.json"));
    DiagnosticsStatusResponse response = client.queryStatus();
    ASSERT_TRUE(response.status);
    EXPECT_FALSE(response.status->ssid || response.status->bssid || response.error);
}

TEST(Replay, TakesMatchingEntriesOneAfterAnotherAndThenTheLast) {
    ReplayDiagnosticsClient client(load("every_form.json"));

    EXPECT_EQ(ask(client, 24).error->text(), "radio busy (code 7)");
    EXPECT_FALSE(ask(client, 24).error);
    EXPECT_FALSE(ask(client, 24).error);
}

TEST(Replay, AnswersWithAnErrorWhereNothingIsRecorded) {
    ReplayDiagnosticsClient client(load("every_form.json"));

    EXPECT_EQ(ask(client, 99).error, (Error{-1, "no recorded answer for test 99"}));
    EXPECT_EQ(ask(client, 34, configuration(60)).error, (Error{-1, "no recorded answer for test 34"}));
    EXPECT_EQ(ask(client, 34, configuration(60, "office")).error->code, -1);
    EXPECT_EQ(ask(client, 24, configuration(60, "Office")).error->code, -1);
    EXPECT_FALSE(ask(client, 34, configuration(60, "Office")).error);
}

TEST(Replay, CountsRequestsThatTheSameEntriesMatch) {
    ReplayDiagnosticsClient client(load("scans_by_age.json"));

    EXPECT_EQ(entry(client, 31, configuration(60)), "any 1");
    EXPECT_EQ(entry(client, 31, configuration(0)), "fresh 1");
    EXPECT_EQ(entry(client, 31, configuration(600)), "any 1");
    EXPECT_EQ(entry(client, 31, configuration(0.0)), "any 1");
    EXPECT_EQ(entry(client, 31, configuration(std::uint64_t{0})), "fresh 2");
    EXPECT_EQ(entry(client, 31, configuration(0)), "fresh 2");
}

TEST(Replay, ComparesAgesAsNumbers) {
    ReplayDiagnosticsClient client(load("scans_by_age.json"));

    EXPECT_EQ(entry(client, 31, configuration(60, "Office")), "office");
    EXPECT_EQ(entry(client, 31, configuration(60.5, "Office")), "no recorded answer for test 31 (code -1)");
    EXPECT_EQ(entry(client, 31, configuration("0")), "any 1");
    EXPECT_EQ(entry(client, 31), "any 1");
}

TEST(Replay, IgnoresTheNetworkNameForTheDeviceTests) {
    ReplayDiagnosticsClient client(load("scans_by_age.json"));

    EXPECT_EQ(entry(client, 14, configuration(60)), "device 1");
    EXPECT_EQ(entry(client, 14, configuration(60, "Elsewhere")), "device 2");
    EXPECT_EQ(entry(client, 14, configuration(60, "Office")), "device 2");
}

TEST(Replay, TreatsElevenTestsAsTheDevicesOwn) {
    int count = 0;
    for (int test = 0; test < 100; ++test) count += isDeviceTest(test) ? 1 : 0;
    EXPECT_EQ(count, 11);
    for (int test : {14, 15, 16, 17, 18, 19, 20, 22, 29, 47, 48}) EXPECT_TRUE(isDeviceTest(test)) << test;
}

TEST(Replay, MakesNewObjectsForEachAnswer) {
    ReplayDiagnosticsClient client(load("every_form.json"));
    auto scan = [&] {
        DiagnosticsTestResponse response = ask(client, 31, configuration(0));
        return std::pair(response.results->front()->info,
                         *response.results->front()->info->value("ScanResults")->as<ArrayPointer>());
    };

    auto [firstInfo, first] = scan();
    auto [secondInfo, second] = scan();

    EXPECT_NE(firstInfo, secondInfo);
    ASSERT_EQ(first->size(), 2U);
    EXPECT_NE(first->front(), second->front());
    EXPECT_EQ(second->front().asRecord<WiFiScanResult>()->ssid, "Northlight");
    EXPECT_EQ(second->front().asRecord<WiFiScanResult>()->rssi, -41);
}

TEST(Replay, JoinsTheResultsOfSeveralRequestsUpToTheFirstError) {
    ReplayDiagnosticsClient client(load("every_form.json"));
    DiagnosticsTestResponse both = client.runTestRequests({{14, nullptr}, {3, nullptr}});
    ASSERT_EQ(both.results->size(), 2U);
    EXPECT_FALSE(both.error);
    DiagnosticsTestResponse broken = client.runTestRequests({{14, nullptr}, {24, nullptr}, {3, nullptr}});
    EXPECT_EQ(broken.results->size(), 1U);
    EXPECT_EQ(broken.error->code, 7);
    EXPECT_TRUE(client.runTestRequests({}).results->empty());
}

TEST(Replay, TakesAsLongAsTheRecordingSays) {
    ReplayDiagnosticsClient client(load("every_form.json"));
    auto begin = Clock::now();
    EXPECT_FALSE(ask(client, 34, configuration(60, "Office")).error);
    EXPECT_GE(Clock::now() - begin, milliseconds(20));
}

TEST(Replay, EndsADelayedAnswerAtOnceWhenCancelled) {
    ReplayDiagnosticsClient client(
        stated(R"("answers": [{"test": 1, "result": true, "delayMs": 2147483647}])"));
    std::vector<std::thread> askers;
    std::vector<DiagnosticsTestResponse> responses(3);
    for (DiagnosticsTestResponse& response : responses)
        askers.emplace_back([&] { response = ask(client, 1); });

    client.cancelAllRequests();
    for (std::thread& asker : askers) asker.join();

    for (const DiagnosticsTestResponse& response : responses) {
        EXPECT_EQ(response.error, (Error{8, "cancelled"}));
        EXPECT_FALSE(response.results);
    }
}

TEST(Replay, AnswersEverythingWithCancelledOnceItWasCancelled) {
    ReplayDiagnosticsClient client(load("every_form.json"));
    client.cancelAllRequests();
    client.cancelAllRequests();

    EXPECT_EQ(ask(client, 14).error, (Error{8, "cancelled"}));
    EXPECT_EQ(ask(client, 99).error, (Error{8, "cancelled"}));
    EXPECT_EQ(client.queryStatus().error, (Error{8, "cancelled"}));
    EXPECT_FALSE(client.queryStatus().status);
}

TEST(Replay, AnswersCapabilitiesThatItKnowsAndDeniesOthers) {
    ReplayCapabilityQuery capabilities(load("every_form.json"));
    EXPECT_TRUE(capabilities.booleanAnswer("wapi"));
    EXPECT_FALSE(capabilities.booleanAnswer("other"));
}

/// A main queue and a Wi-Fi manager on it.
class ReplayWiFi : public testing::Test {
  protected:
    void state(const std::string& keys) {
        service_ = std::make_unique<ReplayWiFiManagerService>(stated(keys), mainQueue_);
        client_ = service_->createClient(0);
        if (!client_) return;
        client_->scheduleWithRunLoop(mainQueue_);
        auto devices = client_->copyDevices();
        if (!devices.empty()) device_ = devices.front();
    }

    /// Notes the power that each call of the callback finds.
    void listen() {
        device_->registerPowerCallback([this] { powers_.push_back(client_->power()); });
    }

    bool runUntilCalls(std::size_t count) {
        return mainQueue_.runUntil([&] { return powers_.size() >= count; },
                                   Clock::now() + milliseconds(60'000));
    }

    Activity activity_;
    MainQueue mainQueue_{activity_};
    std::unique_ptr<ReplayWiFiManagerService> service_;
    std::shared_ptr<WiFiManagerClient> client_;
    std::shared_ptr<WiFiDeviceClient> device_;
    std::vector<int> powers_;
};

TEST_F(ReplayWiFi, HasWhatTheRecordingSays) {
    state(R"("wifi": {"devices": ["wlan3", "wlan4"], "power": false})");

    EXPECT_TRUE(service_->hasRadio());
    ASSERT_EQ(client_->copyDevices().size(), 2U);
    EXPECT_EQ(client_->copyDevices()[1]->interfaceName(), "wlan4");
    EXPECT_EQ(client_->power(), 0);
}

TEST_F(ReplayWiFi, HasNoClientWhereNoneCanBeMade) {
    state(R"("wifi": {"client": false})");
    EXPECT_TRUE(service_->hasRadio());
    EXPECT_FALSE(client_);
    state(R"("wifi": {"radio": false})");
    EXPECT_FALSE(service_->hasRadio());
    EXPECT_FALSE(client_);
    state(R"("wifi": {"devices": []})");
    EXPECT_TRUE(client_->copyDevices().empty());
}

TEST_F(ReplayWiFi, FiresTheCallbackOfSetPowerFromTheRunLoop) {
    state(R"("wifi": {"power": false})");
    listen();

    client_->setPower(1);

    EXPECT_EQ(client_->power(), 1);
    EXPECT_TRUE(powers_.empty());
    mainQueue_.runPending();
    EXPECT_EQ(powers_, std::vector<int>{1});
    client_->setPower(1);
    mainQueue_.runPending();
    EXPECT_EQ(powers_, std::vector<int>{1});
}

TEST_F(ReplayWiFi, IgnoresSetPowerWhereTheRecordingSaysSo) {
    state(R"("wifi": {"power": false, "setPower": "ignored"})");
    listen();
    client_->setPower(1);
    mainQueue_.runPending();
    EXPECT_EQ(client_->power(), 0);
    EXPECT_TRUE(powers_.empty());
}

TEST_F(ReplayWiFi, FiresEventsInTheirOrderAlsoWhenThePowerWasSoAlready) {
    state(
        R"("events": [{"afterMs": 2, "power": false}, {"afterMs": 0, "power": true}, {"afterMs": 1, "power": true}])");
    EXPECT_FALSE(mainQueue_.hasEventsToCome());
    listen();
    EXPECT_TRUE(mainQueue_.hasEventsToCome());
    EXPECT_TRUE(activity_.idle());

    ASSERT_TRUE(runUntilCalls(3));

    EXPECT_EQ(powers_, (std::vector<int>{1, 1, 0}));
    EXPECT_FALSE(mainQueue_.hasEventsToCome());
}

TEST_F(ReplayWiFi, CallsNothingOnceTheCallbackIsUnregistered) {
    state(R"("events": [{"afterMs": 0, "power": false}])");
    listen();
    device_->registerPowerCallback(nullptr);

    mainQueue_.runUntil([&] { return client_->power() == 0; }, Clock::now() + milliseconds(60'000));

    EXPECT_EQ(client_->power(), 0);
    EXPECT_TRUE(powers_.empty());
}

TEST_F(ReplayWiFi, CallsNothingOnceTheDeviceIsReleased) {
    state(R"("wifi": {"power": false})");
    listen();
    client_->setPower(1);
    device_.reset();
    mainQueue_.runPending();
    EXPECT_TRUE(powers_.empty());
}

TEST_F(ReplayWiFi, LetsACallbackUnregisterItself) {
    state(R"("events": [{"afterMs": 0, "power": false}, {"afterMs": 0, "power": true}])");
    device_->registerPowerCallback([this] {
        powers_.push_back(client_->power());
        device_->registerPowerCallback(nullptr);
    });
    mainQueue_.runUntil([&] { return !mainQueue_.hasEventsToCome(); }, Clock::now() + milliseconds(60'000));
    EXPECT_EQ(powers_, std::vector<int>{0});
}

TEST_F(ReplayWiFi, OutlivesNothingThatItsEventsWouldNeed) {
    state(R"("events": [{"afterMs": 0, "power": false}])");
    listen();
    device_.reset();
    client_.reset();
    service_.reset();
    mainQueue_.runUntil([&] { return !mainQueue_.hasEventsToCome(); }, Clock::now() + milliseconds(60'000));
    EXPECT_TRUE(powers_.empty());
}

TEST_F(ReplayWiFi, TakesRegistrationsWhileEventsFire) {
    std::string events;
    for (int i = 0; i < 200; ++i)
        events +=
            (i ? "," : "") + std::string(R"({"afterMs": )") + std::to_string(i / 10) + R"(, "power": true})";
    state("\"events\": [" + events + "]");
    std::atomic<int> calls = 0;
    device_->registerPowerCallback([&calls] { ++calls; });
    std::thread other([&] {
        for (int i = 0; i < 200; ++i) {
            device_->registerPowerCallback(nullptr);
            device_->registerPowerCallback([&calls] { ++calls; });
        }
    });
    mainQueue_.runUntil([&] { return !mainQueue_.hasEventsToCome(); }, Clock::now() + milliseconds(60'000));
    other.join();
    EXPECT_LE(calls, 200);
}

}  // namespace
}  // namespace wp
