#include "linux/workers.h"

#include <gtest/gtest.h>
#include <poll.h>

#include <chrono>
#include <latch>
#include <thread>

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
