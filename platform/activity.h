#pragma once

#include <functional>
#include <mutex>

namespace wp {

/// Counts the work that is queued, delayed or running on the queues of one run, so that a script can wait
/// until nothing is left to happen by itself. *Any* thread.
class Activity {
  public:
    void begin();
    /// Ends one piece of work. Work that it gave rise to was begun before, so the count never touches zero
    /// between.
    void end();
    bool idle() const;

    /// Called on the thread that ended the last piece of work, outside the lock.
    void setIdleHandler(std::function<void()> handler);

  private:
    mutable std::mutex mutex_;
    std::size_t count_ = 0;
    std::function<void()> idleHandler_;
};

}  // namespace wp
