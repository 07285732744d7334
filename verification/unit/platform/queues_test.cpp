#include <gtest/gtest.h>
#include <sys/resource.h>
#include <unistd.h>

#include <atomic>
#include <latch>
#include <system_error>
#include <thread>
#include <vector>

#include "platform/background_queue.h"
#include "platform/main_queue.h"

namespace wp {
namespace {

using namespace std::chrono_literals;

TEST(MainQueue, RunsBlocksInTheirOrderOnTheThreadThatTurnsIt) {
    Activity activity;
    MainQueue queue(activity);
    std::vector<int> order;

    queue.async([&] {
        order.push_back(1);
        queue.async([&] { order.push_back(3); });
    });
    queue.async([&] { order.push_back(2); });
    queue.runPending();

    EXPECT_EQ(order, (std::vector{1, 2, 3}));
    EXPECT_TRUE(activity.idle());
}

TEST(MainQueue, IsTheCurrentQueueOfItsThread) {
    Activity activity;
    {
        MainQueue queue(activity);
        EXPECT_EQ(Queue::current(), &queue);
    }
    EXPECT_EQ(Queue::current(), nullptr);
}

TEST(MainQueue, WaitsForDelayedWorkAndForOtherThreads) {
    Activity activity;
    MainQueue queue(activity);
    BackgroundQueue background(activity);
    std::vector<int> order;

    queue.after(5ms, [&] { order.push_back(2); });
    background.async([&] { queue.async([&] { order.push_back(1); }); });

    EXPECT_TRUE(queue.runUntil([&] { return order.size() == 2; }));
}

TEST(MainQueue, DoesNotCountEventsFromOutsideAsWork) {
    Activity activity;
    MainQueue queue(activity);
    bool happened = false;

    queue.scheduleEvent(1ms, [&] { happened = true; });

    EXPECT_TRUE(activity.idle());
    EXPECT_TRUE(queue.hasEventsToCome());
    EXPECT_TRUE(queue.runUntil([&] { return happened; }));
    EXPECT_FALSE(queue.hasEventsToCome());
}

TEST(MainQueue, AnExpectedEventIsToComeUntilItsTokenGoesOrItsTimeIsOver) {
    Activity activity;
    MainQueue queue(activity);

    std::shared_ptr<void> came = queue.expectEvent(60'000ms);
    EXPECT_TRUE(activity.idle());
    EXPECT_TRUE(queue.hasEventsToCome());
    std::thread elsewhere([&] { came.reset(); });
    EXPECT_TRUE(queue.runUntil([&] { return !queue.hasEventsToCome(); }));
    elsewhere.join();

    std::shared_ptr<void> neverComes = queue.expectEvent(1ms);
    EXPECT_TRUE(queue.runUntil([&] { return !queue.hasEventsToCome(); }));
}

TEST(MainQueue, DropsEverythingOnceItIsClosed) {
    Activity activity;
    MainQueue queue(activity);
    int runs = 0;

    queue.async([&] { ++runs; });
    queue.after(0ms, [&] { ++runs; });
    queue.close();
    queue.async([&] { ++runs; });
    queue.runPending();

    EXPECT_EQ(runs, 0);
    EXPECT_TRUE(activity.idle());
}

TEST(BackgroundQueue, RunsBlocksBesideEachOther) {
    Activity activity;
    BackgroundQueue queue(activity);
    std::latch bothRun(2);

    for (int i = 0; i < 2; ++i) queue.async([&] { bothRun.arrive_and_wait(); });
    queue.drain(BackgroundQueue::Delayed::keep);

    EXPECT_TRUE(bothRun.try_wait());
}

TEST(BackgroundQueue, ABlockThatWaitsDoesNotHoldUpADelayedOne) {
    std::latch released(1);  // outlives the queue, whose thread may still look at it
    Activity activity;
    MainQueue main(activity);
    BackgroundQueue queue(activity);

    queue.async([&] { released.wait(); });
    queue.after(1ms, [&] {
        released.count_down();
        main.wake();
    });

    EXPECT_TRUE(main.runUntil([&] { return released.try_wait(); }, MainQueue::Clock::now() + 60s));
}

TEST(BackgroundQueue, RunsADelayedBlockAtOnceWhereDelaysAreSkipped) {
    Activity activity;
    BackgroundQueue queue(activity, BackgroundQueue::Delays::skipped);
    std::atomic<bool> hasRun = false;

    queue.after(std::chrono::hours(1), [&] { hasRun = true; });
    queue.drain(BackgroundQueue::Delayed::drop);

    EXPECT_TRUE(hasRun);
}

TEST(BackgroundQueue, DropsDelayedBlocksWhenItIsDrainedForGood) {
    Activity activity;
    BackgroundQueue queue(activity);
    std::atomic<bool> ran = false;

    queue.after(1h, [&] { ran = true; });
    queue.drain(BackgroundQueue::Delayed::drop);

    EXPECT_FALSE(ran);
    EXPECT_TRUE(activity.idle());
}

/// From here on the system refuses this process every further thread.
void letNoMoreThreadsBeMade() {
    const rlimit none{0, 0};
    ASSERT_EQ(setrlimit(RLIMIT_NPROC, &none), 0);
    constexpr uid_t nobody = 65534;
    // The limit does not hold for root.
    if (geteuid() == 0) {
        ASSERT_EQ(setresuid(nobody, nobody, nobody), 0);
    }
    ASSERT_THROW(std::thread([] {}).join(), std::system_error);
}

TEST(BackgroundQueue, RunsItsBlocksOnOneThreadWhereTheSystemRefusesMore) {
    const auto runBlocks = [] {
        Activity activity;
        BackgroundQueue queue(activity);
        letNoMoreThreadsBeMade();
        std::atomic<int> count = 0;

        queue.after(1ms, [&] { ++count; });
        queue.async([&] {
            ++count;
            queue.async([&] { ++count; });
        });
        queue.drain(BackgroundQueue::Delayed::keep);
        while (!activity.idle()) std::this_thread::sleep_for(1ms);

        _exit(testing::Test::HasFailure() ? 1 : count.load());
    };
    EXPECT_EXIT(runBlocks(), testing::ExitedWithCode(3), "");
}

TEST(BackgroundQueue, IsNotMadeWhereTheSystemRefusesAThread) {
    const auto make = [] {
        letNoMoreThreadsBeMade();
        Activity activity;
        EXPECT_THROW(BackgroundQueue queue(activity), std::system_error);
        _exit(testing::Test::HasFailure() ? 1 : 0);
    };
    EXPECT_EXIT(make(), testing::ExitedWithCode(0), "");
}

TEST(Activity, TellsWhenTheLastWorkEnds) {
    Activity activity;
    int told = 0;
    activity.setIdleHandler([&] { ++told; });

    activity.begin();
    activity.begin();
    activity.end();
    EXPECT_EQ(told, 0);
    activity.end();

    EXPECT_EQ(told, 1);
}

TEST(SynchronousSubmission, RunsInTheCallersPlace) {
    Activity activity;
    MainQueue main(activity);
    BackgroundQueue queue(activity);
    Queue* runLoop = nullptr;

    queue.sync([&] { runLoop = Queue::current(); });

    EXPECT_EQ(runLoop, &main);
}

}  // namespace
}  // namespace wp
