#include "linux/session.h"

#include <gtest/gtest.h>
#include <linux/rfkill.h>
#include <poll.h>
#include <stdlib.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include "platform/records.h"
#include "verification/unit/linux/conversation.h"

namespace wp {
namespace {

Known<PhaseTopic> topic(int test, Dictionary::Entries configuration) {
    return topicOf(*findTest(test), Dictionary::make(std::move(configuration)));
}

TEST(Topic, TakesAgeAndNameFromTheConfiguration) {
    const auto found = topic(34, {{"MaxScanCacheAge", 1.5}, {"NetworkName", "Office"}});

    ASSERT_TRUE(found);
    EXPECT_EQ(std::chrono::milliseconds(1500), found->oldestScan);
    EXPECT_EQ(nameFromText("Office"), found->named);
}

TEST(Topic, FindsTheBytesOfAnEscapedNameAgain) {
    const std::uint8_t bytes[] = {'a', 0xFF};

    EXPECT_EQ(NetworkName(bytes), topic(34, {{"NetworkName", "a\\xFF"}})->named);
}

TEST(Topic, OfTestsOfTheDeviceAndOfTheJoinedNetworkHasNoName) {
    for (const int test : {14, 3, 35, 31})
        EXPECT_FALSE(topic(test, {{"NetworkName", "Office"}})->named) << test;
}

TEST(Topic, IsOneForAllTestsOfTheSameNetwork) {
    EXPECT_EQ(*topic(34, {{"MaxScanCacheAge", 60}}), *topic(3, {{"MaxScanCacheAge", 60}}));
    EXPECT_NE(*topic(34, {{"MaxScanCacheAge", 60}}), *topic(34, {{"MaxScanCacheAge", 0}}));
    EXPECT_NE(*topic(34, {}), *topic(34, {{"NetworkName", "Office"}}));
}

TEST(Topic, RefusesWhatNoNetworkCanBe) {
    const Dictionary::Entries refused[] = {
        {{"NetworkName", std::string(33, 'a')}}, {{"NetworkName", 7}},          {{"NetworkName", ""}},
        {{"NetworkName", "Cafe_NoMap"}},         {{"MaxScanCacheAge", "soon"}}, {{"MaxScanCacheAge", -1}},
    };
    for (const Dictionary::Entries& each : refused) {
        const auto found = topic(34, each);
        ASSERT_FALSE(found);
        EXPECT_EQ(9, found.error().code);
    }
}

TEST(Topic, IsAboutTheJoinedNetworkWithoutAConfiguration) {
    const auto found = topicOf(*findTest(34), nullptr);

    ASSERT_TRUE(found);
    EXPECT_FALSE(found->named);
}

TEST(Session, AnswersATestThatCannotBeMadeWithItsReason) {
    Conversation conversation;

    conversation.say(
        "{\"id\":1,\"request\":\"test\",\"test\":34,\"configuration\":{\"MaxScanCacheAge\":0}}\n");
    const DiagnosticsTestResponse response = testAnswer(conversation.answer(1));

    ASSERT_TRUE(response.error);
    EXPECT_NE(0, response.error->code);
    EXPECT_FALSE(response.error->message.empty());
}

TEST(Session, AnswersATestThatDoesNotExist) {
    Conversation conversation;

    conversation.say("{\"id\":1,\"request\":\"test\",\"test\":5}\n");

    EXPECT_EQ("no test 5 (code 9)", testAnswer(conversation.answer(1)).error->text());
}

TEST(Session, SaysWhatItDidNotUnderstandAndGoesOn) {
    Conversation conversation;

    conversation.say("nonsense\n{\"id\":2,\"request\":\"status\"}\n");
    const WireMessage first = readMessage(conversation.hear());

    EXPECT_TRUE(std::holds_alternative<Note>(first));
    EXPECT_TRUE(statusAnswer(conversation.answer(2)).error);
}

TEST(Session, DescribesAMachineWithoutTheInterface) {
    Conversation conversation;

    conversation.say("{\"id\":3,\"request\":\"wifi\"}\n");
    const WiFiResponse response = wifiAnswer(conversation.answer(3));

    ASSERT_TRUE(response.wifi);
    EXPECT_TRUE(response.wifi->devices.empty());
    EXPECT_FALSE(response.wifi->power);
}

/// The kernel's device for power switches, with one switch of the machine.
class SwitchDevice {
  public:
    SwitchDevice(std::uint8_t soft, std::uint8_t hard) {
        int ends[2];
        EXPECT_EQ(0, socketpair(AF_UNIX, SOCK_SEQPACKET | SOCK_CLOEXEC | SOCK_NONBLOCK, 0, ends));
        kernel_ = Descriptor(ends[0]);
        const rfkill_event event{4711, RFKILL_TYPE_WLAN, RFKILL_OP_ADD, soft, hard};
        EXPECT_EQ(ssize_t{sizeof event}, write(ends[0], &event, sizeof event));
        power_.emplace(Descriptor(ends[1]));
    }
    PowerSwitch takePower() { return std::move(*power_); }
    /// What was last written to it.
    std::optional<rfkill_event> wish() const {
        rfkill_event event{};
        if (read(kernel_.number(), &event, sizeof event) != ssize_t{sizeof event}) return std::nullopt;
        return event;
    }

  private:
    Descriptor kernel_;
    std::optional<PowerSwitch> power_;
};

TEST(Session, LiftsABlockOfSoftware) {
    SwitchDevice device(1, 0);
    Conversation conversation(device.takePower());

    conversation.say("{\"id\":1,\"request\":\"setPower\",\"power\":true}\n");

    EXPECT_FALSE(setPowerAnswer(conversation.answer(1)));
    const auto wish = device.wish();
    ASSERT_TRUE(wish);
    EXPECT_EQ(0, wish->soft);
}

TEST(Session, SaysThatNoSoftwareLiftsABlockOfHardware) {
    SwitchDevice device(0, 1);
    Conversation conversation(device.takePower());

    conversation.say(
        "{\"id\":1,\"request\":\"setPower\",\"power\":true}\n"
        "{\"id\":2,\"request\":\"setPower\",\"power\":false}\n");

    EXPECT_EQ("a switch on the device itself keeps it off (code 4)",
              setPowerAnswer(conversation.answer(1)).value_or(Error()).text());
    EXPECT_TRUE(device.wish()) << "for when the switch is moved";
    EXPECT_FALSE(setPowerAnswer(conversation.answer(2)));
}

TEST(Session, AnswersEachRequestOnceWhateverIsCancelledMeanwhile) {
    Conversation conversation;
    constexpr std::uint64_t kRequests = 200;
    std::string lines;
    for (std::uint64_t id = 1; id <= kRequests; ++id) {
        const char* const kind = id % 3 == 0 ? "\"status\"" : "\"test\",\"test\":34";
        lines += "{\"id\":" + std::to_string(id) + ",\"request\":" + kind + "}\n";
        if (id % 7 == 0) lines += "{\"request\":\"cancel\"}\n{\"request\":\"cancel\"}\n";
    }

    conversation.say(lines);
    std::vector<int> answers(kRequests + 1);
    for (std::uint64_t heard = 0; heard < kRequests; ++heard) {
        const WireMessage message = readMessage(conversation.hear());
        ASSERT_TRUE(std::holds_alternative<WireAnswer>(message));
        ++answers.at(std::get<WireAnswer>(message).id);
    }

    EXPECT_EQ(std::vector<int>(kRequests, 1), std::vector<int>(answers.begin() + 1, answers.end()));
}

TEST(Session, ServesRequestsAfterItWasCancelled) {
    Conversation conversation;

    conversation.say("{\"request\":\"cancel\"}\n{\"id\":1,\"request\":\"test\",\"test\":34}\n");

    EXPECT_NE(kCancelledCode, testAnswer(conversation.answer(1)).error->code);
}

/// A message bus that takes every connection and never says a word, in place of the system's.
class SilentBus {
  public:
    SilentBus() : listening_(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
        sockaddr_un place{};
        place.sun_family = AF_UNIX;
        const std::string path = ::testing::TempDir() + "/wp-silent-" + std::to_string(getpid());
        path.copy(place.sun_path, sizeof place.sun_path - 1);
        ::unlink(path.c_str());
        EXPECT_EQ(0, ::bind(listening_.number(), reinterpret_cast<sockaddr*>(&place), sizeof place));
        EXPECT_EQ(0, ::listen(listening_.number(), 16));
        setenv("DBUS_SYSTEM_BUS_ADDRESS", ("unix:path=" + path).c_str(), 1);
        path_ = path;
    }
    ~SilentBus() {
        unsetenv("DBUS_SYSTEM_BUS_ADDRESS");
        ::unlink(path_.c_str());
    }

    void waitForACaller() const {
        pollfd entry{listening_.number(), POLLIN, 0};
        ::poll(&entry, 1, -1);
    }

  private:
    Descriptor listening_;
    std::string path_;
};

constexpr const char* kAskBluetoothTwice =
    "{\"id\":1,\"request\":\"test\",\"test\":18}\n{\"id\":2,\"request\":\"test\",\"test\":19}\n";
constexpr const char* kCancelAndAskOnce =
    "{\"request\":\"cancel\"}\n{\"id\":3,\"request\":\"test\",\"test\":5}\n";

TEST(Session, AnswersAllThatWaitsBeforeItReadsOnWhenItIsCancelled) {
    const SilentBus bus;
    Conversation conversation;

    // In one piece: however long the service takes, nothing that it finds out is told before it has read all of this.
    conversation.say(std::string(kAskBluetoothTwice) + kCancelAndAskOnce);

    for (const std::uint64_t id : {1, 2}) {
        const auto answer = std::get<WireAnswer>(readMessage(conversation.hear()));
        EXPECT_EQ(id, answer.id);
        EXPECT_EQ(kCancelledCode, testAnswer(answer).error.value_or(Error()).code);
    }
    EXPECT_EQ(3u, std::get<WireAnswer>(readMessage(conversation.hear())).id);
}

TEST(Session, AnswersWhatIsBeingAskedOfSomebodySilentBeforeItReadsOnWhenItIsCancelled) {
    const SilentBus bus;
    Conversation conversation;

    conversation.say(kAskBluetoothTwice);
    bus.waitForACaller();
    conversation.say(kCancelAndAskOnce);

    for (int i = 0; i < 2; ++i) EXPECT_NE(3u, std::get<WireAnswer>(readMessage(conversation.hear())).id);
    EXPECT_EQ(3u, std::get<WireAnswer>(readMessage(conversation.hear())).id);
}

TEST(Session, EndsInTheMiddleOfItsWorkWhenTheWireIsClosed) {
    Conversation conversation;

    conversation.say("{\"id\":1,\"request\":\"test\",\"test\":31}\n{\"id\":2,\"request\":\"status\"}\n");
}

TEST(LineSocket, PutsLinesTogetherFromPieces) {
    int ends[2];
    ASSERT_EQ(0, socketpair(AF_UNIX, SOCK_STREAM, 0, ends));
    LineSocket reader{Descriptor(ends[0])};
    LineSocket writer{Descriptor(ends[1])};

    writer.send("one\ntw");
    EXPECT_TRUE(reader.receive());
    EXPECT_EQ("one", reader.nextLine());
    EXPECT_EQ(std::nullopt, reader.nextLine());
    writer.send("o\n");
    EXPECT_TRUE(reader.receive());

    EXPECT_EQ("two", reader.nextLine());
}

TEST(Notes, TellEachThingOnce) {
    Notes notes;
    std::vector<std::string> told;
    notes.setTeller([&](const std::string& text) { told.push_back(text); });

    for (const char* text : {"no permission", "another", "no permission"}) notes.once(text);

    EXPECT_EQ((std::vector<std::string>{"no permission", "another"}), told);
}

TEST(Notes, TellOneThingOfASubject) {
    Notes notes;
    std::vector<std::string> told;
    notes.setTeller([&](const std::string& text) { told.push_back(text); });

    notes.once("Bluetooth", "rejected, sender :1.5");
    notes.once("Bluetooth", "rejected, sender :1.6");
    notes.once("pings", "rejected, sender :1.6");

    EXPECT_EQ((std::vector<std::string>{"rejected, sender :1.5", "rejected, sender :1.6"}), told);
}

TEST(StopSignal, EndsAWaitAndStaysRaised) {
    const auto stop = std::make_shared<StopSignal>();
    std::thread other([stop] { stop->raise(); });

    const Wait wait = waitReadable(-1, {stop, Clock::now() + std::chrono::hours(1)});
    other.join();
    stop->raise();

    EXPECT_EQ(Wait::stopped, wait);
    EXPECT_TRUE(stop->raised());
}

}  // namespace
}  // namespace wp
