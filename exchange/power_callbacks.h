#pragma once

#include <functional>
#include <map>
#include <mutex>

#include "platform/queue.h"

namespace wp {

/// The power callbacks that are registered at the moment, by device handle. *Any* thread.
class PowerCallbacks {
  public:
    using Callback = std::function<void()>;

    /// Registers the callback for the handle, in place of an earlier one; an empty one unregisters.
    void set(const void* handle, Callback callback);

    /// Calls each callback that is still registered when its turn comes, outside the lock.
    void call();

  private:
    std::mutex mutex_;
    std::map<const void*, Callback> callbacks_;
};

}  // namespace wp
