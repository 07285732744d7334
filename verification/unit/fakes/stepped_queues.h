#pragma once

#include <algorithm>
#include <chrono>
#include <deque>
#include <map>
#include <optional>

#include "platform/queue.h"

namespace wp::fakes {

/// A main queue and a background queue that run their blocks on the test's own thread, one at a time and only
/// when told to, with delays that pass on a clock of their own. The test's thread counts as the main thread.
class SteppedQueues {
  public:
    using Duration = std::chrono::milliseconds;

    SteppedQueues() : main_(*this, &main_), background_(*this, nullptr) { main_.makeCurrent(); }
    ~SteppedQueues() { main_.makeNoneCurrent(); }
    SteppedQueues(const SteppedQueues&) = delete;
    SteppedQueues& operator=(const SteppedQueues&) = delete;

    Queue& main() { return main_; }
    Queue& background() { return background_; }

    /// Each runs the first block that is ready; false when there is none.
    bool runOneOnMain() { return main_.runOne(); }
    bool runOneInBackground() { return background_.runOne(); }

    /// Run what is ready on one queue, and what that makes ready there.
    void runMain() {
        while (runOneOnMain()) {
        }
    }
    void runBackground() {
        while (runOneInBackground()) {
        }
    }

    /// Runs both queues until nothing is ready; the clock stands still.
    void runReady() {
        while (runOneOnMain() || runOneInBackground()) {
        }
    }

    /// Moves the clock on, running what becomes due at its moment, and all that follows from it.
    void advance(Duration time) {
        Duration end = now_ + time;
        runReady();
        while (std::optional<Duration> next = nextDeadline()) {
            if (*next > end) break;
            now_ = *next;
            main_.releaseDue(now_);
            background_.releaseDue(now_);
            runReady();
        }
        now_ = end;
    }

    /// Runs everything, delayed blocks included, until nothing is left.
    void runAll() {
        runReady();
        while (std::optional<Duration> next = nextDeadline()) advance(*next - now_);
    }

    Duration now() const { return now_; }
    std::size_t readyOnMain() const { return main_.ready_.size(); }
    std::size_t readyInBackground() const { return background_.ready_.size(); }

    /// The moment of the next delayed block.
    std::optional<Duration> nextDeadline() const {
        std::optional<Duration> next;
        for (const SteppedQueue* queue : {&main_, &background_}) {
            if (queue->delayed_.empty()) continue;
            Duration first = queue->delayed_.begin()->first;
            next = next ? std::min(*next, first) : first;
        }
        return next;
    }

  private:
    class SteppedQueue final : public Queue {
      public:
        SteppedQueue(SteppedQueues& owner, Queue* runLoop) : owner_(owner), runLoop_(runLoop) {}

        void async(Block block) override { ready_.push_back(std::move(block)); }
        void after(Duration delay, Block block) override {
            delayed_.emplace(owner_.now_ + delay, std::move(block));
        }

        bool runOne() {
            if (ready_.empty()) return false;
            Block block = std::move(ready_.front());
            ready_.pop_front();
            Queue* before = current();
            setCurrent(runLoop_);
            block();
            setCurrent(before);
            return true;
        }

        void releaseDue(Duration now) {
            while (!delayed_.empty() && delayed_.begin()->first <= now) {
                ready_.push_back(std::move(delayed_.begin()->second));
                delayed_.erase(delayed_.begin());
            }
        }

        void makeCurrent() { setCurrent(this); }
        void makeNoneCurrent() { setCurrent(nullptr); }

        SteppedQueues& owner_;
        Queue* runLoop_;
        std::deque<Block> ready_;
        std::multimap<Duration, Block> delayed_;
    };

    Duration now_{0};
    SteppedQueue main_;
    SteppedQueue background_;
};

}  // namespace wp::fakes
