#include "linux/workers.h"

#include <gtest/gtest.h>
#include <poll.h>

#include <chrono>
#include <latch>
#include <thread>

#include "linux/within_memory.h"

namespace wp {
namespace {

/// Turns the inbox until so many publications have run.
void publish(Inbox& inbox, const std::size_t& done, std::size_t wanted) {
    while (done < wanted) {
        pollfd waiting{inbox.descriptor(), POLLIN, 0};
        ASSERT_GT(poll(&waiting, 1, 10'000), 0) << "after " << done;
        inbox.run();
    }
}

TEST(WorkersTest, PiecesThatWaitForEachOtherAllRunAtOnceAndPublishOnTheOwnersThread) {
    constexpr int kPieces = 12;
    Inbox inbox;
    Workers workers(inbox);
    std::latch all(kPieces);
    std::size_t published = 0;
    for (int i = 0; i < kPieces; ++i) {
        workers.start([&, owner = std::this_thread::get_id()]() -> Workers::Publication {
            all.arrive_and_wait();
            return [&, owner] { published += std::this_thread::get_id() == owner ? 1 : 0; };
        });
    }
    publish(inbox, published, kPieces);
    EXPECT_EQ(published, kPieces);
}

TEST(WithinMemory, AFactThatNoMemoryIsLeftForIsAnErrorThatSaysSo) {
    const Known<std::string> fits = withinMemory([]() -> Known<std::string> { return std::string("a"); });
    const Known<std::string> tooMuch = withinMemory([]() -> Known<std::string> { throw std::bad_alloc(); });
    ASSERT_TRUE(fits);
    EXPECT_EQ(*fits, "a");
    ASSERT_FALSE(tooMuch);
    EXPECT_EQ(tooMuch.error().message, "there is not enough memory");
}

TEST(WorkersTest, WhatIsStillWorkedOnWhenTheyGoIsWaitedForAndDropped) {
    Inbox inbox;
    bool isDone = false;
    bool isPublished = false;
    std::latch begun(1);
    {
        Workers workers(inbox);
        workers.start([&]() -> Workers::Publication {
            begun.count_down();
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
            isDone = true;
            return [&] { isPublished = true; };
        });
        begun.wait();
    }
    EXPECT_TRUE(isDone);
    EXPECT_FALSE(isPublished);
}

}  // namespace
}  // namespace wp
