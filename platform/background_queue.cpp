#include "platform/background_queue.h"

#include <system_error>

namespace wp {

BackgroundQueue::BackgroundQueue(Activity& activity, Delays delays) : activity_(activity), delays_(delays) {
    std::lock_guard lock(mutex_);
    makeThread();
}

BackgroundQueue::~BackgroundQueue() {
    std::vector<std::thread> threads;
    std::list<Block> dropped;
    {
        std::unique_lock lock(mutex_);
        closing_ = true;
        dropped.splice(dropped.end(), ready_);
        dropDelayed(lock);
        threads.swap(threads_);
    }
    changed_.notify_all();
    for (std::size_t i = dropped.size(); i > 0; --i) activity_.end();
    for (std::thread& thread : threads) thread.join();
}

void BackgroundQueue::async(Block block) {
    activity_.begin();
    bool isRefused = false;
    {
        std::lock_guard lock(mutex_);
        isRefused = closing_;
        if (!isRefused) {
            ready_.push_back(std::move(block));
            makeThreadIfNeeded();
        }
    }
    changed_.notify_one();
    if (isRefused) activity_.end();
}

void BackgroundQueue::after(std::chrono::milliseconds delay, Block block) {
    if (delays_ == Delays::skipped) return async(std::move(block));
    activity_.begin();
    bool isRefused = false;
    {
        std::lock_guard lock(mutex_);
        isRefused = closing_;
        if (!isRefused) {
            delayed_.emplace(Clock::now() + delay, std::move(block));
            makeThreadIfNeeded();
        }
    }
    changed_.notify_all();
    if (isRefused) activity_.end();
}

void BackgroundQueue::makeThreadIfNeeded() {
    // One thread more than there is ready work for keeps watch over the delayed blocks.
    std::size_t wanted = ready_.size() + (delayed_.empty() ? 0 : 1);
    if (waiting_ >= wanted) return;
    try {
        makeThread();
    } catch (const std::system_error&) {
        // The threads that there are come to the block after their own.
    }
}

void BackgroundQueue::makeThread() {
    threads_.emplace_back([this] { work(); });
    ++waiting_;
}

void BackgroundQueue::work() {
    std::unique_lock lock(mutex_);
    for (;;) {
        if (!delayed_.empty() && delayed_.begin()->first <= Clock::now()) {
            ready_.push_back(std::move(delayed_.begin()->second));
            delayed_.erase(delayed_.begin());
        }
        if (ready_.empty()) {
            if (closing_) return;
            if (delayed_.empty()) {
                changed_.wait(lock);
            } else {
                Clock::time_point until = delayed_.begin()->first;
                changed_.wait_until(lock, until);
            }
            continue;
        }
        Block block = std::move(ready_.front());
        ready_.pop_front();
        --waiting_;
        ++running_;
        makeThreadIfNeeded();
        lock.unlock();
        block();
        block = nullptr;  // what the block kept alive goes before the work counts as done
        activity_.end();
        lock.lock();
        ++waiting_;
        --running_;
        if (running_ == 0 && ready_.empty()) drained_.notify_all();
    }
}

void BackgroundQueue::drain(Delayed delayed) {
    std::unique_lock lock(mutex_);
    if (delayed == Delayed::drop) dropDelayed(lock);
    drained_.wait(lock, [this] { return running_ == 0 && ready_.empty(); });
    if (delayed == Delayed::drop) dropDelayed(lock);
}

void BackgroundQueue::dropDelayed(std::unique_lock<std::mutex>& lock) {
    std::multimap<Clock::time_point, Block> dropped;
    dropped.swap(delayed_);
    lock.unlock();
    std::size_t count = dropped.size();
    dropped.clear();
    for (std::size_t i = 0; i < count; ++i) activity_.end();
    lock.lock();
}

}  // namespace wp
