#pragma once

#include <condition_variable>
#include <list>
#include <map>
#include <mutex>
#include <thread>
#include <vector>

#include "platform/activity.h"
#include "platform/queue.h"

namespace wp {

/// The global background queue: concurrent, so that a block that waits for a service never keeps another from
/// running. Threads are made as they are needed and reused; where the system refuses another one, blocks wait for
/// those that there are. *Any* thread.
class BackgroundQueue final : public Queue {
  public:
    /// With `Delays::skipped` a delayed block is ready at once: for a run whose end nobody watches.
    enum class Delays { kept, skipped };
    /// Makes the first thread. Throws std::system_error where the system refuses even that.
    explicit BackgroundQueue(Activity& activity, Delays delays = Delays::kept);
    /// Waits for the blocks that run; drops those that have not begun.
    ~BackgroundQueue() override;

    void async(Block block) override;
    void after(std::chrono::milliseconds delay, Block block) override;

    /// Blocks until nothing runs and nothing is ready to run. With `Delayed::drop` blocks whose time has not
    /// come are dropped first. Must not be called from a block of this queue.
    enum class Delayed { keep, drop };
    void drain(Delayed delayed);

  private:
    using Clock = std::chrono::steady_clock;

    void work();
    void makeThreadIfNeeded();
    void makeThread();
    void dropDelayed(std::unique_lock<std::mutex>& lock);

    Activity& activity_;
    const Delays delays_;
    std::mutex mutex_;
    std::condition_variable changed_;
    std::condition_variable drained_;
    std::list<Block> ready_;
    std::multimap<Clock::time_point, Block> delayed_;
    std::vector<std::thread> threads_;
    std::size_t waiting_ = 0;
    std::size_t running_ = 0;
    bool closing_ = false;
};

}  // namespace wp
