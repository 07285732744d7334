#include "linux/home_channel.h"

#include <gtest/gtest.h>

#include <future>

#include "verification/unit/linux/stop.h"

namespace wp {
namespace {

using std::chrono::milliseconds;
using enum HomeChannel::Visit;

Until atOnce() {
    return patience(milliseconds(0));
}

TEST(HomeChannel, IsLeftWhereNobodyNeedsIt) {
    HomeChannel home;
    EXPECT_EQ(Wait::ready, home.leave(brief, patience()));
    home.returned();
    EXPECT_EQ(Wait::ready, home.leave(lengthy, patience()));
}

TEST(HomeChannel, IsNotLeftWhileSomebodyNeedsIt) {
    HomeChannel home;
    HomeChannel::Stay stay(home);
    EXPECT_EQ(Wait::timeout, home.leave(brief, atOnce()));
    EXPECT_EQ(Wait::timeout, home.leave(lengthy, atOnce()));
    EXPECT_EQ(Wait::ready, stay.begin(patience()));
    EXPECT_EQ(Wait::timeout, home.leave(brief, atOnce()));
}

TEST(HomeChannel, IsLeftBrieflyInAPause) {
    HomeChannel home;
    HomeChannel::Stay stay(home);
    stay.pause();
    stay.pause();
    EXPECT_EQ(Wait::timeout, home.leave(lengthy, atOnce()));
    EXPECT_EQ(Wait::ready, home.leave(brief, patience()));
}

TEST(HomeChannel, IsNeededAgainAfterAPause) {
    HomeChannel home;
    HomeChannel::Stay stay(home);
    stay.pause();
    EXPECT_EQ(Wait::ready, stay.begin(patience()));
    EXPECT_EQ(Wait::ready, stay.begin(patience()));
    EXPECT_EQ(Wait::timeout, home.leave(brief, atOnce()));
}

TEST(HomeChannel, IsLeftOnlyWhereAllAgree) {
    HomeChannel home;
    HomeChannel::Stay one(home);
    one.pause();
    {
        const HomeChannel::Stay other(home);
        EXPECT_EQ(Wait::timeout, home.leave(brief, atOnce()));
    }
    EXPECT_EQ(Wait::ready, home.leave(brief, patience()));
}

TEST(HomeChannel, IsNotNeededAfterTheEndWhateverFollows) {
    HomeChannel home;
    HomeChannel::Stay stay(home);
    stay.end();
    EXPECT_EQ(Wait::ready, stay.begin(patience()));
    stay.pause();
    stay.end();
    EXPECT_EQ(Wait::ready, home.leave(lengthy, patience()));
}

TEST(HomeChannel, IsLeftByAWaitingVisitorAsSoonAsItMay) {
    HomeChannel home;
    HomeChannel::Stay stay(home);
    auto visitor = std::async(std::launch::async, [&] {
        const Wait wait = home.leave(brief, patience());
        home.returned();
        return wait == Wait::ready ? home.leave(lengthy, patience()) : wait;
    });
    stay.pause();
    stay.end();
    EXPECT_EQ(Wait::ready, visitor.get());
}

TEST(HomeChannel, IsAwaitedWhileTheRadioIsAway) {
    HomeChannel home;
    ASSERT_EQ(Wait::ready, home.leave(brief, patience()));
    HomeChannel::Stay stay(home);
    EXPECT_EQ(Wait::timeout, stay.begin(patience(milliseconds(20))));
    home.returned();
    const Clock::time_point returned = Clock::now();
    EXPECT_EQ(Wait::ready, stay.begin(patience()));
    EXPECT_GE(Clock::now() - returned, kAtHome - milliseconds(1));
}

TEST(HomeChannel, IsAwaitedByNobodyWhoIsStopped) {
    HomeChannel home;
    ASSERT_EQ(Wait::ready, home.leave(brief, patience()));
    HomeChannel::Stay stay(home);
    const auto stop = std::make_shared<StopSignal>();
    stop->raise();
    EXPECT_EQ(Wait::stopped, stay.begin(patience(milliseconds(20'000), stop)));
    EXPECT_EQ(Wait::stopped, home.leave(brief, patience(milliseconds(20'000), stop)));
}

TEST(HomeChannel, CountsNoTimeAway) {
    HomeChannel home;
    HomeChannel::Stay stay(home);
    stay.pause();
    ASSERT_EQ(Wait::ready, home.leave(brief, patience()));
    const Clock::duration before = stay.timeAtHome();
    const Clock::time_point away = Clock::now();
    EXPECT_EQ(Wait::timeout, stay.begin(patience(milliseconds(20))));
    EXPECT_EQ(before, stay.timeAtHome());
    const Clock::duration atLeastAway = Clock::now() - away;
    home.returned();
    EXPECT_LE(stay.timeAtHome(), Clock::now() - away + before - atLeastAway);
    EXPECT_GE(stay.timeAtHome(), before);
}

}  // namespace
}  // namespace wp
