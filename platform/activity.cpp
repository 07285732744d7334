#include "platform/activity.h"

namespace wp {

void Activity::begin() {
    std::lock_guard lock(mutex_);
    ++count_;
}

void Activity::end() {
    std::function<void()> handler;
    {
        std::lock_guard lock(mutex_);
        if (--count_ == 0) handler = idleHandler_;
    }
    if (handler) handler();
}

bool Activity::idle() const {
    std::lock_guard lock(mutex_);
    return count_ == 0;
}

void Activity::setIdleHandler(std::function<void()> handler) {
    std::lock_guard lock(mutex_);
    idleHandler_ = std::move(handler);
}

}  // namespace wp
