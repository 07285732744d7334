#include "exchange/live.h"

#include <dirent.h>
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <algorithm>
#include <cerrno>
#include <condition_variable>
#include <filesystem>
#include <fstream>
#include <future>
#include <mutex>
#include <thread>

#include "exchange/service_process.h"
#include "platform/activity.h"
#include "platform/main_queue.h"
#include "platform/records.h"

namespace wp {
namespace {

using std::chrono::milliseconds;
using Clock = std::chrono::steady_clock;

constexpr milliseconds kLong(60'000);

std::size_t openDescriptors() {
    std::filesystem::directory_iterator files("/proc/self/fd");
    return static_cast<std::size_t>(std::distance(begin(files), end(files)));
}

/// Whether this process has no child any more, neither alive nor waiting to be reaped.
bool hasNoChild() {
    return ::waitpid(-1, nullptr, WNOHANG) == -1 && errno == ECHILD;
}

/// A live service whose process does what the script of the test says, and the notes that came.
class Live : public testing::Test {
  protected:
    void SetUp() override { descriptors_ = openDescriptors(); }
    void TearDown() override {
        service_.reset();
        EXPECT_TRUE(hasNoChild());
        EXPECT_EQ(openDescriptors(), descriptors_);
    }

    static ServiceProcess startedProcess(const std::vector<std::string>& script) {
        return std::get<ServiceProcess>(ServiceProcess::start(besideProgram("scripted_service"), script));
    }
    void start(const std::vector<std::string>& script, milliseconds deadline = kLong) {
        adopt(startedProcess(script), deadline);
    }
    void adopt(ServiceProcess process, milliseconds deadline = kLong) {
        LiveServiceOptions options;
        options.testDeadline = deadline;
        options.queryDeadline = deadline;
        options.note = [this](std::string_view text) {
            std::lock_guard lock(mutex_);
            notes_.emplace_back(text);
            noted_.notify_all();
        };
        options.expectPowerChange = expectPowerChange_;
        service_ = std::make_unique<LiveService>(std::move(process), std::move(options));
    }

    DiagnosticsTestResponse ask(int test) {
        return service_->diagnostics().runTestRequests({{test, nullptr}});
    }
    std::string errorOf(int test) {
        DiagnosticsTestResponse response = ask(test);
        return response.error ? response.error->text() : "no error";
    }
    std::vector<std::string> notes() {
        std::lock_guard lock(mutex_);
        return notes_;
    }

    bool waitForNotes(std::size_t count) {
        std::unique_lock lock(mutex_);
        return noted_.wait_for(lock, kLong, [&] { return notes_.size() >= count; });
    }

    std::function<std::shared_ptr<void>()> expectPowerChange_;
    std::size_t descriptors_ = 0;
    std::mutex mutex_;
    std::condition_variable noted_;
    std::vector<std::string> notes_;
    std::unique_ptr<LiveService> service_;
};

TEST_F(Live, AsksTheServiceAndReadsItsAnswers) {
    start({R"("test":34)", R"(answer:{"result":true,"didPass":false,"info":{"BeaconInterval":300}})",
           R"("test":24)", R"(answer:{"error":{"code":6,"message":"not permitted"}})", "status",
           R"(answer:{"status":{"ssid":"Home"}})"});

    DiagnosticsTestResponse response =
        service_->diagnostics().runTestRequests({{34, Dictionary::make({{"NetworkName", "Home"}})}});

    ASSERT_TRUE(response.results);
    EXPECT_TRUE(response.results->front()->result);
    EXPECT_EQ(response.results->front()->info->value("BeaconInterval"), Value(300));
    EXPECT_EQ(errorOf(24), "not permitted (code 6)");
    EXPECT_EQ(service_->diagnostics().queryStatus().status->ssid, "Home");
    EXPECT_FALSE(service_->failure());
}

TEST_F(Live, KeepsManyRequestsFromManyThreadsApart) {
    std::vector<std::string> script;
    for (int test = 10; test < 30; ++test) {
        script.push_back("\"test\":" + std::to_string(test));
        script.push_back(R"(answer:{"result":true,"info":{"test":)" + std::to_string(test) + "}}");
    }
    start(script);
    std::vector<std::thread> askers;
    std::vector<int> wrong(20);
    for (int asker = 0; asker < 20; ++asker)
        askers.emplace_back([this, asker, &wrong] {
            for (int round = 0; round < 20; ++round) {
                int test = 10 + (asker + round) % 20;
                DiagnosticsTestResponse response = ask(test);
                bool isRight =
                    response.results && response.results->front()->info->value("test") == Value(test);
                wrong[static_cast<std::size_t>(asker)] += isRight ? 0 : 1;
            }
        });
    for (std::thread& asker : askers) asker.join();
    EXPECT_EQ(wrong, std::vector<int>(20, 0));
}

TEST_F(Live, SaysWhyAServiceCannotBeStarted) {
    const auto started = ServiceProcess::start("/nonexistent/wifi-profile-service", {});
    ASSERT_TRUE(std::holds_alternative<Refusal>(started));
    EXPECT_EQ(std::get<Refusal>(started).text(),
              "/nonexistent/wifi-profile-service: cannot be started: No such file or directory");
}

TEST_F(Live, TakesTheFirstLineAndLeavesTheRest) {
    const std::string line(9000, 'x');
    ServiceProcess process =
        startedProcess({"start", "send:" + line + "\n{\"note\":\"behind it\"}", "test", "answer:{}"});

    EXPECT_EQ(process.firstLine(kLong), line);

    adopt(std::move(process));
    EXPECT_EQ(errorOf(1), "no error");
    EXPECT_EQ(notes(), std::vector<std::string>{"behind it"});
}

TEST_F(Live, HasNoFirstLineOfAProcessThatEndsHangsOrCloses) {
    EXPECT_EQ(startedProcess({"start", "exit:3"}).firstLine(kLong), std::nullopt);
    EXPECT_EQ(startedProcess({"start", "part:half"}).firstLine(milliseconds(20)), std::nullopt);
    EXPECT_EQ(startedProcess({"start", "close"}).firstLine(kLong), std::nullopt);
    EXPECT_EQ(startedProcess({"start", "flood"}).firstLine(kLong), std::nullopt);
}

TEST_F(Live, SaysHowAServiceEnded) {
    start({R"("test":1)", "exit:3"});
    EXPECT_EQ(errorOf(1), "wifi-profile-service ended (exit status 3) (code 4)");
    EXPECT_EQ(errorOf(2), "wifi-profile-service ended (exit status 3) (code 4)");
    EXPECT_EQ(notes(), std::vector<std::string>{"wifi-profile-service ended (exit status 3)"});

    start({R"("test":1)", "crash"});
    EXPECT_EQ(errorOf(1), "wifi-profile-service ended (signal 9, Killed) (code 4)");
    EXPECT_EQ(service_->failure()->code, 4);

    start({R"("test":1)", "forbidden"});
    EXPECT_EQ(errorOf(1),
              "wifi-profile-service ended (signal 31, Bad system call: its sandbox forbids what it was about "
              "to do) "
              "(code 4)");

    start({R"("test":1)", "close"});
    EXPECT_EQ(errorOf(1), "wifi-profile-service closed the connection (code 4)");

    start({R"("test":1)", "part:{\"id\":1,", R"("test":2)", "exit:0"});
    std::thread other([this] { EXPECT_EQ(ask(1).error->code, 4); });
    EXPECT_EQ(ask(2).error->code, 4);
    other.join();
}

TEST_F(Live, GivesUpAServiceThatAnswersNothingInTime) {
    start({R"("test":1)", "hang"}, milliseconds(20));
    EXPECT_EQ(errorOf(1), "wifi-profile-service gave no answer to test 1 within 20 ms (code 7)");
    EXPECT_EQ(errorOf(2), "wifi-profile-service gave no answer to test 1 within 20 ms (code 7)");
    EXPECT_FALSE(service_->wifi().hasRadio());

    start({"start", "deaf"}, milliseconds(20));
    EXPECT_EQ(service_->diagnostics().queryStatus().error->text(),
              "wifi-profile-service gave no answer to the status query within 20 ms (code 7)");
}

TEST_F(Live, GivesUpAServiceThatTalksNonsense) {
    start({R"("test":1)", "send:hello"});
    EXPECT_EQ(ask(1).error->code, 10);
    EXPECT_EQ(
        notes().at(0).find("wifi-profile-service sent what is no message: line 1, column 1: not valid JSON"),
        0U);

    start({R"("test":1)", R"(send:{"id":77,"result":true})"});
    EXPECT_EQ(errorOf(1), "wifi-profile-service answered a request that was never made: 77 (code 10)");

    start({R"("test":1)", "flood"});
    EXPECT_EQ(errorOf(1), "wifi-profile-service sent a line longer than 16777216 bytes (code 10)");
}

TEST_F(Live, RefusesOneAnswerOfAnotherFormAndGoesOn) {
    start({R"("test":1)", R"(answer:{"result":"yes"})", R"("test":2)", R"(answer:{"result":true})", "status",
           "answer:{}"});
    EXPECT_EQ(errorOf(1),
              "wifi-profile-service gave an answer of another form: result: must be true or false (code 10)");
    EXPECT_EQ(service_->diagnostics().queryStatus().error->code, 10);
    EXPECT_EQ(errorOf(2), "no error");
    EXPECT_FALSE(service_->failure());
}

/// What makes the service tell that it has the request, and nothing else.
constexpr const char* kHangWithNote = R"(send:{"note":"asked"})";

TEST_F(Live, CancelsWhatIsOutstandingAlsoWhenTheServiceHangs) {
    start({R"("test")", kHangWithNote, "status", kHangWithNote});
    std::vector<std::future<DiagnosticsTestResponse>> outstanding;
    for (int test = 1; test <= 5; ++test)
        outstanding.push_back(std::async(std::launch::async, [this, test] { return ask(test); }));
    auto status = std::async(std::launch::async, [this] { return service_->diagnostics().queryStatus(); });
    ASSERT_TRUE(waitForNotes(6));

    service_->diagnostics().cancelAllRequests();

    for (auto& response : outstanding) EXPECT_EQ(response.get().error, (Error{8, "cancelled"}));
    EXPECT_EQ(status.get().error, (Error{8, "cancelled"}));
    EXPECT_FALSE(service_->failure());
}

TEST_F(Live, AnswersEverythingWithCancelledOnceItWasCancelled) {
    start({"test", R"(answer:{"result":true})"});
    EXPECT_EQ(errorOf(1), "no error");
    service_->diagnostics().cancelAllRequests();
    service_->diagnostics().cancelAllRequests();
    EXPECT_EQ(errorOf(1), "cancelled (code 8)");
    EXPECT_EQ(service_->diagnostics().queryStatus().error, (Error{8, "cancelled"}));
}

TEST_F(Live, CancelsEvenWhenNothingMoreCanBeSent) {
    start({"start", "deaf"});
    DictionaryPointer big = Dictionary::make({{"NetworkName", std::string(4 << 20, 'x')}});
    auto outstanding = std::async(std::launch::async, [this, big] {
        return service_->diagnostics().runTestRequests({{1, big}});
    });
    service_->diagnostics().cancelAllRequests();
    EXPECT_EQ(outstanding.get().error, (Error{8, "cancelled"}));
}

TEST_F(Live, LetsTheAnswerToACancelledRequestComeLate) {
    start({R"("test":1)", kHangWithNote, "cancel",
           R"(send:{"id":1,"error":{"code":8,"message":"cancelled"}})", "wifi", R"(answer:{"wifi":{}})"});
    auto outstanding = std::async(std::launch::async, [this] { return ask(1); });
    ASSERT_TRUE(waitForNotes(1));

    service_->diagnostics().cancelAllRequests();

    EXPECT_EQ(outstanding.get().error, (Error{8, "cancelled"}));
    EXPECT_TRUE(service_->wifi().hasRadio());  // its answer comes after the late one
    EXPECT_FALSE(service_->failure());
}

TEST_F(Live, HandsOnTheNotesOfTheService) {
    start({"start", R"(send:{"note":"no permission to scan"})", R"("test":1)", "answer:{}"});
    EXPECT_EQ(errorOf(1), "no error");
    EXPECT_EQ(notes(), std::vector<std::string>{"no permission to scan"});
}

TEST_F(Live, GivesTheServiceItsArgumentsAndTheWireAlone) {
    start({R"("test":1)", R"(answer:{"result":true})"});
    EXPECT_EQ(errorOf(1), "no error");
    // the scripted service is this process's only child
    std::ifstream children("/proc/self/task/" + std::to_string(::getpid()) + "/children");
    std::string child;
    children >> child;
    ASSERT_FALSE(child.empty());
    std::vector<int> open;
    for (const auto& entry : std::filesystem::directory_iterator("/proc/" + child + "/fd"))
        open.push_back(std::stoi(entry.path().filename()));
    std::sort(open.begin(), open.end());
    EXPECT_EQ(open, (std::vector<int>{0, 1, 2, 3}));
    EXPECT_EQ(std::filesystem::read_symlink("/proc/" + child + "/fd/1"), "/dev/null");
}

/// The Wi-Fi manager of a live service, on a main queue.
class LiveWiFi : public Live {
  protected:
    LiveWiFi() {
        expectPowerChange_ = [this] { return mainQueue_.expectEvent(kLong); };
    }
    bool connect() {
        client_ = service_->wifi().createClient(0);
        if (!client_) return false;
        client_->scheduleWithRunLoop(mainQueue_);
        auto devices = client_->copyDevices();
        if (devices.empty()) return false;
        device_ = devices.front();
        device_->registerPowerCallback([this] { powers_.push_back(client_->power()); });
        return true;
    }
    bool runUntilCalls(std::size_t count) {
        return mainQueue_.runUntil([&] { return powers_.size() >= count; }, Clock::now() + kLong);
    }

    Activity activity_;
    MainQueue mainQueue_{activity_};
    std::shared_ptr<WiFiManagerClient> client_;
    std::shared_ptr<WiFiDeviceClient> device_;
    std::vector<int> powers_;
};

TEST_F(LiveWiFi, DescribesTheRadio) {
    start({"wifi", R"(answer:{"wifi":{"radio":true,"client":true,"devices":["wlan7"],"power":false}})"});
    EXPECT_TRUE(service_->wifi().hasRadio());
    ASSERT_TRUE(connect());
    EXPECT_EQ(device_->interfaceName(), "wlan7");
    EXPECT_EQ(client_->power(), 0);
}

TEST_F(LiveWiFi, HasNoneWhereTheServiceSaysSoOrCannotSay) {
    start({"wifi", R"(answer:{"wifi":{"radio":false}})"});
    EXPECT_FALSE(service_->wifi().hasRadio());
    EXPECT_FALSE(connect());
    start({"wifi", R"(answer:{"wifi":{"client":false}})"});
    EXPECT_TRUE(service_->wifi().hasRadio());
    EXPECT_FALSE(connect());
    start({"wifi", R"(answer:{"error":{"code":4,"message":"no nl80211"}})"});
    EXPECT_FALSE(service_->wifi().hasRadio());
    EXPECT_EQ(notes(), std::vector<std::string>{"the Wi-Fi radio cannot be asked for: no nl80211 (code 4)"});
}

TEST_F(LiveWiFi, CallsTheCallbackFromTheRunLoopUponEvents) {
    start({"wifi", R"(answer:{"wifi":{"power":false}})", "setPower", "send:{\"event\":{\"power\":true}}"});
    ASSERT_TRUE(connect());
    client_->setPower(1);
    ASSERT_TRUE(runUntilCalls(1));
    EXPECT_EQ(powers_, std::vector<int>{1});
}

TEST_F(LiveWiFi, NotesWhyPowerCouldNotBeSet) {
    start({"wifi", R"(answer:{"wifi":{"power":false}})", "setPower",
           R"(answer:{"error":{"code":6,"message":"blocked by hardware"}})", "status",
           R"(answer:{"status":{}})"});
    ASSERT_TRUE(connect());
    client_->setPower(1);
    service_->diagnostics().queryStatus();
    EXPECT_EQ(notes(), std::vector<std::string>{"Wi-Fi could not be switched: blocked by hardware (code 6)"});
    EXPECT_EQ(client_->power(), 0);
}

TEST_F(LiveWiFi, ExpectsTheChangeOfPowerThatWasAskedForUntilItComes) {
    start({"wifi", R"(answer:{"wifi":{"power":false}})", "setPower", "answer:{}", "status",
           "answer:{\"status\":{}}\n{\"event\":{\"power\":true}}"});
    ASSERT_TRUE(connect());
    client_->setPower(1);
    EXPECT_TRUE(mainQueue_.hasEventsToCome());
    service_->diagnostics().queryStatus();
    ASSERT_TRUE(runUntilCalls(1));
    EXPECT_TRUE(mainQueue_.runUntil([&] { return !mainQueue_.hasEventsToCome(); }, Clock::now() + kLong));
    EXPECT_TRUE(notes().empty());
}

TEST_F(LiveWiFi, ExpectsNoChangeWhereThereIsNoneOrNoneCanBe) {
    start({"wifi", R"(answer:{"wifi":{"power":false}})", "setPower",
           R"(answer:{"error":{"code":6,"message":"blocked by hardware"}})", "status",
           R"(answer:{"status":{}})"});
    ASSERT_TRUE(connect());
    client_->setPower(0);
    EXPECT_FALSE(mainQueue_.hasEventsToCome());
    client_->setPower(1);
    service_->diagnostics().queryStatus();
    EXPECT_FALSE(mainQueue_.hasEventsToCome());
}

TEST_F(LiveWiFi, NeverCoversNewerNewsWithOlder) {
    start({"wifi", "answer:{\"wifi\":{\"power\":true}}\n{\"event\":{\"power\":false}}", "status",
           R"(answer:{"status":{}})"});
    ASSERT_TRUE(connect());
    service_->diagnostics().queryStatus();
    EXPECT_EQ(client_->power(), 0);
}

TEST_F(LiveWiFi, LetsHandlesOutliveTheService) {
    start({"wifi", R"(answer:{"wifi":{}})"});
    ASSERT_TRUE(connect());
    service_.reset();
    client_->setPower(0);
    EXPECT_EQ(client_->power(), 1);
    device_.reset();
    client_.reset();
}

}  // namespace
}  // namespace wp
