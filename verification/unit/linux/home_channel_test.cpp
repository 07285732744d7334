#include "linux/home_channel.h"

#include <gtest/gtest.h>

#include <atomic>
#include <future>
#include <thread>

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

TEST(HomeChannel, IsLeftInSpiteOfAStayWhoseTimeIsOver) {
    HomeChannel home;
    HomeChannel::Stay stay(home, milliseconds(20));
    EXPECT_EQ(Wait::ready, home.leave(lengthy, patience()));
    home.returned();
    EXPECT_EQ(Wait::ready, stay.begin(patience()));
    EXPECT_EQ(Wait::ready, home.leave(brief, patience()));
}

TEST(HomeChannel, IsKeptByAStayThatIsProlonged) {
    HomeChannel home;
    HomeChannel::Stay stay(home, milliseconds(0));
    stay.prolong(std::chrono::hours(1));
    EXPECT_EQ(Wait::timeout, home.leave(brief, atOnce()));
}

TEST(HomeChannel, IsAwayWhereOthersTakeTheRadioWithoutAsking) {
    HomeChannel home;
    HomeChannel::Stay stay(home);
    home.leftByOthers();
    EXPECT_EQ(Wait::timeout, stay.begin(patience(milliseconds(20))));
    home.returned();
    EXPECT_EQ(Wait::ready, stay.begin(patience()));
}

TEST(HomeChannel, IsLeftByAWaitingVisitorAsSoonAsItMay) {
    for (const HomeChannel::Visit visit : {brief, lengthy}) {
        HomeChannel home;
        HomeChannel::Stay stay(home);
        std::atomic isRefused = false;
        auto visitor = std::async(std::launch::async, [&] {
            isRefused = home.leave(visit, atOnce()) == Wait::timeout;
            return isRefused ? home.leave(visit, patience()) : Wait::timeout;
        });
        while (!isRefused) std::this_thread::yield();
        std::this_thread::sleep_for(milliseconds(5));  // most likely it waits again by now
        if (visit == brief)
            stay.pause();
        else
            stay.end();
        EXPECT_EQ(Wait::ready, visitor.get());
    }
}

TEST(HomeChannel, IsAwaitedWhileTheRadioIsAway) {
    HomeChannel home;
    ASSERT_EQ(Wait::ready, home.leave(brief, patience()));
    HomeChannel::Stay stay(home);
    EXPECT_EQ(Wait::timeout, stay.begin(patience(milliseconds(20))));
    const Clock::time_point beforeReturn = Clock::now();
    home.returned();
    EXPECT_EQ(Wait::ready, stay.begin(patience()));
    EXPECT_GE(Clock::now() - beforeReturn, kAtHome);
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
    const Clock::duration after = stay.timeAtHome();
    EXPECT_LE(after, before + (Clock::now() - away) - atLeastAway);
    EXPECT_GE(after, before);
}

}  // namespace
}  // namespace wp
