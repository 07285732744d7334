#pragma once

#include <atomic>
#include <chrono>
#include <functional>
#include <optional>
#include <thread>

namespace wp::host {

/// Watches for what breaks a run off: SIGINT, SIGTERM, SIGHUP (unless it was ignored from the start) and the
/// end of the time that it was given. The signals are blocked in the thread that makes the watcher and in all
/// threads made later, and taken by a thread of the watcher's own, so that they work while any other thread
/// hangs.
class Interruption {
  public:
    struct Actions {
        /// The first interruption: called once, on the watcher's thread.
        std::function<void()> onInterrupted;
        /// Called on the watcher's thread just before the process is left without ceremony, because a second
        /// signal came or the run did not end within the time for it.
        std::function<void()> onLeaving;
    };

    /// *Main*, before any other thread is made.
    explicit Interruption(Actions actions, std::optional<std::chrono::milliseconds> timeout);
    ~Interruption();
    Interruption(const Interruption&) = delete;
    Interruption& operator=(const Interruption&) = delete;

    /// The exit status of a run that was broken off; nothing when it was not. *Any*.
    std::optional<int> exitStatus() const;

  private:
    void watch();
    void interrupt(int signal);
    int pollTimeout() const;

    Actions actions_;
    std::optional<std::chrono::steady_clock::time_point> deadline_;
    int signals_ = -1;
    int stop_ = -1;
    std::atomic<int> signal_ = 0;
    std::thread thread_;
};

}  // namespace wp::host
