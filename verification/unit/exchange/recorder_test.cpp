#include "exchange/recorder.h"

#include <gtest/gtest.h>

#include <future>

#include "exchange/replay.h"
#include "platform/activity.h"
#include "platform/json_writer.h"
#include "platform/main_queue.h"
#include "verification/unit/exchange/recordings.h"
#include "verification/unit/fakes/fake_wifi_manager.h"

namespace wp {
namespace {

using std::chrono::milliseconds;
using Clock = std::chrono::steady_clock;

/// The recording as text, without how long the answers took.
std::string timeless(Recording recording) {
    for (RecordedAnswer& answer : recording.answers) answer.delay = milliseconds(0);
    return recordingText(recording);
}

/// A recording that is replayed, and the recorder that listens.
class Listening {
  public:
    explicit Listening(RecordingPointer recording)
        : diagnostics_(recording), wifi_(recording, mainQueue_), capabilities_(recording) {}

    void ask(int test, DictionaryPointer dictionary = nullptr) {
        recorder_.diagnostics().runTestRequests({{test, std::move(dictionary)}});
    }
    void connect() {
        recorder_.wifi().hasRadio();
        client_ = recorder_.wifi().createClient(0);
        if (!client_) return;
        client_->scheduleWithRunLoop(mainQueue_);
        device_ = client_->copyDevices().at(0);
        client_->power();
        device_->registerPowerCallback([this] { ++calls_; });
    }
    bool runUntilCalls(int count) {
        return mainQueue_.runUntil([&] { return calls_ >= count; }, Clock::now() + milliseconds(60'000));
    }

    Activity activity_;
    MainQueue mainQueue_{activity_};
    ReplayDiagnosticsClient diagnostics_;
    ReplayWiFiManagerService wifi_;
    ReplayCapabilityQuery capabilities_;
    Recorder recorder_{diagnostics_, wifi_, capabilities_};
    std::shared_ptr<WiFiManagerClient> client_;
    std::shared_ptr<WiFiDeviceClient> device_;
    int calls_ = 0;
};

/// One conversation that uses everything in `every_form.json`.
Recording converse(RecordingPointer recording) {
    Listening listening(std::move(recording));
    for (int query = 0; query < 5; ++query) listening.recorder_.diagnostics().queryStatus();
    listening.recorder_.capabilities().booleanAnswer("wapi");
    listening.recorder_.setAutomation(true);
    listening.recorder_.setDescription("every form an entry can take");
    listening.connect();
    EXPECT_TRUE(listening.runUntilCalls(2));
    listening.ask(14, configuration(60, "Office"));
    listening.ask(34, configuration(60, "Office"));
    listening.ask(31, configuration(0));
    for (int test : {24, 25, 26, 27, 28, 46, 3, 24}) listening.ask(test, configuration(60));
    return listening.recorder_.recording();
}

TEST(Recorder, WritesDownWhatWasAnswered) {
    Recording original = accepted(loadRecording(kFolder + "every_form.json"));

    Recording recording = converse(std::make_shared<const Recording>(original));

    EXPECT_GE(recording.answers[1].delay, milliseconds(20));
    ASSERT_EQ(recording.events.size(), 2U);
    EXPECT_GE(recording.events[1].after, milliseconds(1500));
    recording.events = {original.events[1], original.events[0]};  // in the order in which they came
    original.events = recording.events;
    original.answers[2].maxScanCacheAge.reset();
    EXPECT_EQ(timeless(recording), timeless(original));
}

TEST(Recorder, GivesAnEquivalentRecordingOfARecording) {
    RecordingPointer original = stated(R"("status": [{"ssid": "Home"}, {}], "answers": [
        {"test": 31, "maxScanCacheAge": 0, "result": false, "info": {"n": 1}},
        {"test": 31, "result": false, "info": {"n": 2}},
        {"test": 31, "maxScanCacheAge": 0, "result": false, "info": {"n": 3}},
        {"test": 32, "networkName": "Office", "result": true}])");
    auto play = [](RecordingPointer recording) {
        Listening listening(std::move(recording));
        for (int age : {60, 0, 0, 60, 0, 0}) listening.ask(31, configuration(age));
        listening.ask(32, configuration(60, "Office"));
        listening.ask(32, configuration(60));
        listening.recorder_.diagnostics().queryStatus();
        return listening.recorder_.recording();
    };

    Recording second = play(original);
    Recording third = play(std::make_shared<const Recording>(second));

    EXPECT_EQ(timeless(third), timeless(second));
    EXPECT_EQ(second.answers[1].response.results->front()->info->value("n"), Value(1));
}

TEST(Recorder, NotesAgesOnlyWhereTheyTellRequestsApart) {
    Listening listening(stated(R"("answers": [{"test": 31}, {"test": 32}])"));

    listening.ask(31, nullptr);
    listening.ask(31, configuration(0));
    listening.ask(32, configuration(60));
    listening.ask(32, configuration(60));

    Recording recording = listening.recorder_.recording();
    ASSERT_EQ(recording.answers.size(), 4U);
    EXPECT_EQ(recording.answers[0].maxScanCacheAge, Value(0));
    for (std::size_t i = 1; i < 4; ++i) EXPECT_FALSE(recording.answers[i].maxScanCacheAge) << i;
}

TEST(Recorder, NotesTheNetworkButNotForTheDeviceTests) {
    Listening listening(stated(R"("answers": [{"test": 14}, {"test": 34, "networkName": "Office"}])"));

    listening.ask(14, configuration(60, "Office"));
    listening.ask(34, configuration(60, "Office"));

    Recording recording = listening.recorder_.recording();
    EXPECT_FALSE(recording.answers[0].networkName);
    EXPECT_EQ(recording.answers[1].networkName, "Office");
}

TEST(Recorder, LeavesOutWhatHasNoAnswerYet) {
    Listening listening(stated(R"("answers": [{"test": 1, "delayMs": 100000000}, {"test": 2}])"));
    auto waiting = std::async(std::launch::async, [&] { listening.ask(1); });
    listening.ask(2);

    Recording early = listening.recorder_.recording();
    listening.recorder_.diagnostics().cancelAllRequests();
    waiting.get();
    Recording late = listening.recorder_.recording();

    ASSERT_EQ(early.answers.size(), 1U);
    EXPECT_EQ(early.answers[0].test, 2);
    ASSERT_EQ(late.answers.size(), 2U);
    EXPECT_EQ(late.answers[0].response.error.value_or(late.answers[1].response.error.value_or(Error{})),
              (Error{8, "cancelled"}));
}

TEST(Recorder, IsAsAnEmptyRecordingWhereNothingWasAsked) {
    Listening listening(stated(R"("wifi": {"radio": false}, "capabilities": {"wapi": true})"));
    EXPECT_EQ(recordingText(listening.recorder_.recording()), recordingText(Recording()));
}

TEST(Recorder, DescribesTheWiFiHardware) {
    Listening listening(stated(R"("wifi": {"devices": ["wlan3"], "power": false})"));
    listening.connect();
    EXPECT_EQ(listening.recorder_.recording().wifi, (WiFiDescription{true, true, {"wlan3"}, false, {}}));

    Listening clientless(stated(R"("wifi": {"client": false})"));
    clientless.connect();
    EXPECT_FALSE(clientless.recorder_.recording().wifi.client);

    Listening radioless(stated(R"("wifi": {"radio": false})"));
    radioless.connect();
    EXPECT_FALSE(radioless.recorder_.recording().wifi.radio);
    EXPECT_TRUE(radioless.recorder_.recording().wifi.client);
}

TEST(Recorder, LeavesOutThePowerChangeThatSetPowerCaused) {
    Listening listening(stated(R"("wifi": {"power": false})"));
    listening.connect();

    listening.client_->setPower(1);
    ASSERT_TRUE(listening.runUntilCalls(1));

    Recording recording = listening.recorder_.recording();
    EXPECT_TRUE(recording.events.empty());
    EXPECT_FALSE(recording.wifi.power);
    EXPECT_EQ(recording.wifi.setPower, WiFiDescription::SetPower::works);
}

TEST(Recorder, KeepsPowerChangesFromOutside) {
    Listening listening(
        stated(R"("events": [{"afterMs": 0, "power": true}, {"afterMs": 3, "power": false}])"));
    listening.connect();
    ASSERT_TRUE(listening.runUntilCalls(2));
    listening.client_->setPower(1);
    ASSERT_TRUE(listening.runUntilCalls(3));

    Recording recording = listening.recorder_.recording();

    ASSERT_EQ(recording.events.size(), 2U);
    EXPECT_TRUE(recording.events[0].power);
    EXPECT_FALSE(recording.events[1].power);
    EXPECT_GE(recording.events[1].after, milliseconds(3));
}

TEST(Recorder, SaysThatAWishForPowerWasIgnored) {
    Listening listening(stated(R"("wifi": {"power": false, "setPower": "ignored"})"));
    listening.connect();
    listening.client_->setPower(1);
    listening.mainQueue_.runPending();
    EXPECT_EQ(listening.recorder_.recording().wifi.setPower, WiFiDescription::SetPower::ignored);
}

TEST(Recorder, LeavesOutAFulfilledWishAlsoBehindAChangeFromOutside) {
    RecordingPointer nothing = stated(R"("answers": [])");
    ReplayDiagnosticsClient diagnostics(nothing);
    ReplayCapabilityQuery capabilities(nothing);
    fakes::FakeWiFiManager wifi;
    wifi.setInitialPower(0);
    wifi.setObeysSetPower(false);
    Recorder recorder(diagnostics, wifi, capabilities);
    Activity activity;
    MainQueue mainQueue(activity);
    auto client = recorder.wifi().createClient(0);
    client->scheduleWithRunLoop(mainQueue);
    auto device = client->copyDevices().at(0);
    client->power();
    device->registerPowerCallback([] {});

    client->setPower(1);
    for (int power : {0, 1}) {
        wifi.turnPower(power);
        mainQueue.runPending();
    }

    Recording recording = recorder.recording();
    ASSERT_EQ(recording.events.size(), 1U);
    EXPECT_FALSE(recording.events[0].power);
    EXPECT_EQ(recording.wifi.setPower, WiFiDescription::SetPower::works);
}

}  // namespace
}  // namespace wp
