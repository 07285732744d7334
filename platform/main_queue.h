#pragma once

#include <condition_variable>
#include <cstdint>
#include <deque>
#include <map>
#include <memory>
#include <mutex>
#include <optional>

#include "platform/activity.h"
#include "platform/queue.h"

namespace wp {

/// The main queue: blocks run one after another on the thread that made it, whenever that thread turns the
/// queue. A front end with an event loop of its own turns it from there (`setWakeHandler`, `nextDeadline`,
/// `runPending`); one without waits in `runUntil`. Submitting: *Any* thread; all else: *Main*.
class MainQueue final : public Queue {
  public:
    using Clock = std::chrono::steady_clock;

    /// The calling thread becomes the main thread.
    explicit MainQueue(Activity& activity);
    ~MainQueue() override;

    void async(Block block) override;
    void after(std::chrono::milliseconds delay, Block block) override;

    /// Like `after` for something that comes from outside (a power switch, a timeout): not work that is
    /// waited for.
    void scheduleEvent(std::chrono::milliseconds delay, Block block);

    /// An event from outside that nobody can date: it counts as still to come until the last copy of the token
    /// goes, on any thread but before the queue does, or until the time is over. *Any* thread.
    std::shared_ptr<void> expectEvent(std::chrono::milliseconds longest);

    /// Whether an event from outside is still to come.
    bool hasEventsToCome() const;

    /// Runs what is due, and what that makes due, until nothing is.
    void runPending();

    /// The moment at which the next delayed block is due; nothing when there is none.
    std::optional<Clock::time_point> nextDeadline() const;

    /// Runs blocks as they become due until the condition holds or the time is over. The condition is asked
    /// before every wait. Returns whether it holds.
    bool runUntil(const std::function<bool()>& condition,
                  std::optional<Clock::time_point> end = std::nullopt);

    /// Called (on any thread, under no lock) when there is something new to run or `runUntil` should look
    /// again.
    void setWakeHandler(std::function<void()> handler);

    /// Makes a waiting `runUntil` ask its condition again. *Any* thread.
    void wake();

    /// Drops what has not run yet: no block runs afterwards.
    void close();

  private:
    struct Entry {
        Block block;
        bool isWork = true;
        /// Of an expected event: gone when it came.
        std::optional<std::weak_ptr<void>> token;

        bool isToCome() const { return !isWork && !(token && token->expired()); }
    };

    void add(std::chrono::milliseconds delay, Entry entry);
    bool runOne();

    Activity& activity_;
    mutable std::mutex mutex_;
    std::condition_variable changed_;
    std::deque<Entry> ready_;
    std::multimap<Clock::time_point, Entry> delayed_;
    std::function<void()> wakeHandler_;
    std::uint64_t wakes_ = 0;
    bool closed_ = false;
};

}  // namespace wp
