#include "linux/workers.h"

#include <system_error>

namespace wp {
namespace {

// Facts come in bursts, and what a thread has used of its stack stays in memory as long as the thread.
constexpr std::size_t kMostIdle = 1;

}  // namespace

Workers::~Workers() {
    {
        const std::lock_guard lock(mutex_);
        isClosed_ = true;
    }
    changed_.notify_all();
    for (std::thread& each : threads_) each.join();
}

void Workers::start(std::function<Publication()> work) {
    {
        const std::lock_guard lock(mutex_);
        waiting_.push_back(std::move(work));
        if (waiting_.size() <= idle_) return changed_.notify_one();
    }
    const Place place = threads_.emplace(threads_.end());
    try {
        *place = std::thread([this, place] { this->work(place); });
    } catch (const std::system_error&) {
        threads_.erase(place);
        if (threads_.empty()) throw;
    }
}

/// Waits for a piece of work; false where enough threads do, or none will come.
bool Workers::isNeeded(std::unique_lock<std::mutex>& lock) {
    if (isClosed_ || (waiting_.empty() && idle_ == kMostIdle)) return false;
    ++idle_;
    changed_.wait(lock, [this] { return isClosed_ || !waiting_.empty(); });
    --idle_;
    return !isClosed_;
}

void Workers::work(Place place) {
    std::unique_lock lock(mutex_);
    while (isNeeded(lock)) {
        std::function<Publication()> piece = std::move(waiting_.front());
        waiting_.pop_front();
        lock.unlock();
        inbox_.post(piece());
        piece = nullptr;  // an idle thread holds on to nothing
        lock.lock();
    }
    if (isClosed_) return;
    inbox_.post([this, place] {
        place->join();
        threads_.erase(place);
    });
}

}  // namespace wp
