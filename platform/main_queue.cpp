#include "platform/main_queue.h"

#include <algorithm>

namespace wp {

MainQueue::MainQueue(Activity& activity) : activity_(activity) {
    setCurrent(this);
}

MainQueue::~MainQueue() {
    close();
    if (current() == this) setCurrent(nullptr);
}

void MainQueue::async(Block block) {
    add(std::chrono::milliseconds(0), {std::move(block), true, {}});
}

void MainQueue::after(std::chrono::milliseconds delay, Block block) {
    add(delay, {std::move(block), true, {}});
}

void MainQueue::scheduleEvent(std::chrono::milliseconds delay, Block block) {
    add(delay, {std::move(block), false, {}});
}

std::shared_ptr<void> MainQueue::expectEvent(std::chrono::milliseconds longest) {
    std::shared_ptr<void> token(this, [](MainQueue* queue) { queue->wake(); });
    add(longest, {[] {}, false, token});
    return token;
}

void MainQueue::add(std::chrono::milliseconds delay, Entry entry) {
    if (entry.isWork) activity_.begin();
    std::optional<Entry> refused;
    {
        std::lock_guard lock(mutex_);
        if (closed_) {
            refused = std::move(entry);
        } else if (delay.count() <= 0 && entry.isWork) {
            ready_.push_back(std::move(entry));
        } else {
            delayed_.emplace(Clock::now() + delay, std::move(entry));
        }
    }
    if (!refused) {
        wake();
    } else if (refused->isWork) {
        activity_.end();
    }
}

void MainQueue::wake() {
    std::function<void()> handler;
    {
        std::lock_guard lock(mutex_);
        ++wakes_;
        handler = wakeHandler_;
    }
    changed_.notify_all();
    if (handler) handler();
}

bool MainQueue::runOne() {
    Entry entry;
    {
        std::lock_guard lock(mutex_);
        while (!delayed_.empty() && delayed_.begin()->first <= Clock::now()) {
            ready_.push_back(std::move(delayed_.begin()->second));
            delayed_.erase(delayed_.begin());
        }
        if (ready_.empty()) return false;
        entry = std::move(ready_.front());
        ready_.pop_front();
    }
    entry.block();
    entry.block = nullptr;  // what the block kept alive goes before the work counts as done
    if (entry.isWork) activity_.end();
    return true;
}

void MainQueue::runPending() {
    while (runOne()) {
    }
}

bool MainQueue::hasEventsToCome() const {
    std::lock_guard lock(mutex_);
    return std::any_of(ready_.begin(), ready_.end(), [](const Entry& entry) { return entry.isToCome(); }) ||
           std::any_of(delayed_.begin(), delayed_.end(),
                       [](const auto& item) { return item.second.isToCome(); });
}

std::optional<MainQueue::Clock::time_point> MainQueue::nextDeadline() const {
    std::lock_guard lock(mutex_);
    if (!ready_.empty()) return Clock::now();
    if (delayed_.empty()) return std::nullopt;
    return delayed_.begin()->first;
}

bool MainQueue::runUntil(const std::function<bool()>& condition, std::optional<Clock::time_point> end) {
    for (;;) {
        std::uint64_t seen = 0;
        {
            std::lock_guard lock(mutex_);
            seen = wakes_;
        }
        runPending();
        if (condition()) return true;
        if (end && Clock::now() >= *end) return false;
        std::unique_lock lock(mutex_);
        auto isChanged = [&] { return wakes_ != seen || !ready_.empty(); };
        std::optional<Clock::time_point> until = end;
        if (!delayed_.empty())
            until = until ? std::min(*until, delayed_.begin()->first) : delayed_.begin()->first;
        if (until) {
            changed_.wait_until(lock, *until, isChanged);
        } else {
            changed_.wait(lock, isChanged);
        }
    }
}

void MainQueue::setWakeHandler(std::function<void()> handler) {
    std::lock_guard lock(mutex_);
    wakeHandler_ = std::move(handler);
}

void MainQueue::close() {
    std::deque<Entry> dropped;
    {
        std::lock_guard lock(mutex_);
        closed_ = true;
        dropped = std::move(ready_);
        ready_.clear();
        for (auto& item : delayed_) dropped.push_back(std::move(item.second));
        delayed_.clear();
    }
    for (Entry& entry : dropped) {
        entry.block = nullptr;
        if (entry.isWork) activity_.end();
    }
}

}  // namespace wp
