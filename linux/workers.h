#pragma once

#include <functional>
#include <list>
#include <thread>

#include "linux/inbox.h"

namespace wp {

/// Threads that each do one piece of work and hand what comes of it to the owner's thread.
class Workers {
  public:
    /// What is left to do with the outcome, on the owner's thread.
    using Publication = std::function<void()>;

    explicit Workers(Inbox& inbox) : inbox_(inbox) {}
    /// Waits for all threads; whoever stops must have told them. What they hand over then is dropped.
    ~Workers();

    /// Runs `work` on a thread of its own and then what it returns on the owner's. The owner's thread.
    void start(std::function<Publication()> work);
    /// What work has to say before it is done, for the owner's thread. *Any* thread.
    void post(Publication publication) { inbox_.post(std::move(publication)); }

  private:
    Inbox& inbox_;
    std::list<std::thread> threads_;
};

}  // namespace wp
