#include "screens/remote/remote_control.h"

#include <gtest/gtest.h>

#include <thread>

#include "platform/background_queue.h"
#include "screens/headless/headless_screen.h"
#include "verification/unit/screens/sample_controller.h"

namespace wp::remote {
namespace {

using namespace std::chrono_literals;

class RemoteControlTest : public testing::Test {
  protected:
    RemoteControlTest() {
        controller->buildViews();
        screen.setRootViewController(controller);
        screen.setBackHandler([this] { isOver = true; });
        screen.focusPreferredView();
    }

    std::optional<std::string> play(const std::string& text) {
        Script script = readScript(text, Pictures::refused);
        EXPECT_EQ(script.error, std::nullopt);
        return RemoteControl({screen, frontEnd, queue, activity, [this] { return isOver; },
                              [this](std::string_view line) { transcript.emplace_back(line); }})
            .play(script);
    }

    Activity activity;
    MainQueue queue{activity};
    std::shared_ptr<SampleController> controller = std::make_shared<SampleController>();
    ui::Screen screen;
    headless::HeadlessScreen frontEnd{screen, queue};
    std::vector<std::string> transcript;
    bool isOver = false;
};

TEST_F(RemoteControlTest, PressesKeysUntilTheRunIsOver) {
    auto reason = play("down select select back down");

    EXPECT_EQ(reason, std::nullopt);
    EXPECT_EQ(controller->chosen, "Café");
    EXPECT_TRUE(isOver);
}

TEST_F(RemoteControlTest, IgnoresStepsThatAreLeftWhenTheRunIsOver) {
    auto reason = play("back screen type:x");

    EXPECT_EQ(reason, std::nullopt);
    EXPECT_TRUE(transcript.empty());
}

TEST_F(RemoteControlTest, TypesIntoTheFocusedField) {
    auto reason =
        play("down down down select type:Ab clear 'type:My  net' left type:! down right select back");

    EXPECT_EQ(reason, std::nullopt);
    EXPECT_EQ(controller->selected, "My  ne!t");
}

TEST_F(RemoteControlTest, FailsWhereNoFieldHasTheFocus) {
    EXPECT_EQ(play("up type:x"), "token 2 \"type:x\": no text field has the focus");
    EXPECT_EQ(play("clear"), "token 1 \"clear\": no text field has the focus");
    EXPECT_EQ(play("select type:x"), "token 2 \"type:x\": no text field has the focus");  // only actions
}

TEST_F(RemoteControlTest, SaysThatNobodyCanPressAKey) {
    EXPECT_EQ(play("down"), "the run waits for a key, and on this screen nobody can press one");
}

TEST_F(RemoteControlTest, RunsTheMainQueueEmptyBeforeEachStep) {
    queue.async(
        [this] { queue.async([this] { controller->names.clear(), controller->table().reloadData(); }); });

    play("screen back");

    ASSERT_EQ(transcript.size(), 1U);
    EXPECT_EQ(transcript[0].find("Office"), std::string::npos);
}

TEST_F(RemoteControlTest, WaitsUntilNoWorkIsLeftOnAnyQueue) {
    BackgroundQueue background(activity);
    bool isDone = false;
    background.async([&] {
        std::this_thread::sleep_for(5ms);
        background.after(5ms, [&] { queue.after(5ms, [&] { isDone = true; }); });
    });

    play("wait back");

    EXPECT_TRUE(isDone);
}

TEST_F(RemoteControlTest, DoesNotWaitForEventsThatAreStillToCome) {
    bool hasCome = false;
    queue.scheduleEvent(1h, [&] { hasCome = true; });

    play("wait screen back");

    EXPECT_EQ(transcript.size(), 1U);
    EXPECT_FALSE(hasCome);
}

TEST_F(RemoteControlTest, AnEventThatIsStillToComeKeepsTheRunGoing) {
    queue.scheduleEvent(5ms, [this] { isOver = true; });

    EXPECT_EQ(play("wait"), std::nullopt);
    EXPECT_TRUE(isOver);
}

TEST_F(RemoteControlTest, LetsTheTimeOfASleepPass) {
    auto begin = std::chrono::steady_clock::now();

    play("sleep:30 back");

    EXPECT_GE(std::chrono::steady_clock::now() - begin, 30ms);
}

TEST_F(RemoteControlTest, LeavesTheRunGoingWhenTheScriptIsOver) {
    queue.after(10ms, [this] { queue.after(10ms, [this] { isOver = true; }); });

    EXPECT_EQ(play("screen"), std::nullopt);
    EXPECT_TRUE(isOver);
}

}  // namespace
}  // namespace wp::remote
