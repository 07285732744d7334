#pragma once

#include <mutex>
#include <utility>

namespace wp {

/// One value that several threads read and write, each time as a whole. *Any* thread.
template <class T>
class Synchronized {
  public:
    Synchronized() = default;
    explicit Synchronized(T value) : value_(std::move(value)) {}

    T get() const {
        std::lock_guard lock(mutex_);
        return value_;
    }

    void set(T value) { exchange(std::move(value)); }

    /// Stores the value and returns the one that it replaces, which so is never destroyed under the lock.
    T exchange(T value) {
        std::lock_guard lock(mutex_);
        std::swap(value_, value);
        return value;
    }

    /// Lets the function look at and change the value as one step. It must not use this object.
    template <class Function>
    auto update(Function function) {
        std::lock_guard lock(mutex_);
        return function(value_);
    }

  private:
    mutable std::mutex mutex_;
    T value_{};
};

}  // namespace wp
