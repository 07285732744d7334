#pragma once

#include <condition_variable>
#include <deque>
#include <functional>
#include <list>
#include <mutex>
#include <thread>

#include "linux/inbox.h"

namespace wp {

/// Threads that each do one piece of work at a time and hand what comes of it to the owner's thread. A piece never
/// waits for another: where no thread is idle a further one begins. One is kept for what comes next.
class Workers {
  public:
    /// What is left to do with the outcome, on the owner's thread.
    using Publication = std::function<void()>;

    explicit Workers(Inbox& inbox) : inbox_(inbox) {}
    /// Waits for all threads; whoever stops must have told them. What they hand over then is dropped.
    ~Workers();

    /// Runs `work` on a thread that has nothing else to do and then what it returns on the owner's. Where the system gives
    /// no further thread the work waits for one of those that are there; without any this throws. The owner's thread.
    void start(std::function<Publication()> work);

  private:
    using Place = std::list<std::thread>::iterator;

    void work(Place place);
    bool isNeeded(std::unique_lock<std::mutex>& lock);

    Inbox& inbox_;
    std::mutex mutex_;
    std::condition_variable changed_;
    std::deque<std::function<Publication()>> waiting_;
    std::size_t idle_ = 0;  ///< threads that wait for a piece
    bool isClosed_ = false;
    std::list<std::thread> threads_;  ///< the owner's thread
};

}  // namespace wp
