#include "exchange/power_callbacks.h"

#include <vector>

namespace wp {

void PowerCallbacks::set(const void* handle, Callback callback) {
    std::lock_guard lock(mutex_);
    if (callback) {
        std::swap(callbacks_[handle], callback);
    } else {
        auto found = callbacks_.find(handle);
        if (found == callbacks_.end()) return;
        std::swap(found->second, callback);
        callbacks_.erase(found);
    }
    // An earlier callback dies with the parameter, after the lock.
}

void PowerCallbacks::call() {
    std::vector<const void*> handles;
    {
        std::lock_guard lock(mutex_);
        for (const auto& [handle, callback] : callbacks_) handles.push_back(handle);
    }
    for (const void* handle : handles) {
        Callback callback;
        {
            std::lock_guard lock(mutex_);
            auto found = callbacks_.find(handle);
            if (found != callbacks_.end()) callback = found->second;
        }
        if (callback) callback();
    }
}

}  // namespace wp
