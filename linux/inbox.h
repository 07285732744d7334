#pragma once

#include <functional>
#include <mutex>
#include <vector>

#include "exchange/descriptor.h"

namespace wp {

/// Steps that other threads hand to the one that owns the state. `descriptor()` can be read while steps wait.
class Inbox {
  public:
    Inbox();

    /// *Any* thread.
    void post(std::function<void()> step);
    /// Runs the steps that wait, in their order. The owner's thread.
    void run();
    int descriptor() const { return event_.number(); }

  private:
    Descriptor event_;
    std::mutex mutex_;
    std::vector<std::function<void()>> steps_;
};

}  // namespace wp
