#pragma once

#include <atomic>
#include <chrono>
#include <memory>

#include "exchange/descriptor.h"
#include "service/known.h"

namespace wp {

using Clock = std::chrono::steady_clock;

/// Ends whatever waits with it. *Any* thread; raising it again changes nothing.
class StopSignal {
  public:
    StopSignal();
    void raise();
    bool raised() const { return raised_; }
    int descriptor() const { return event_.number(); }

  private:
    std::atomic<bool> raised_ = false;  ///< asked without a call
    Descriptor event_;
};

/// How long something may take: until its time is over or it is stopped.
struct Until {
    std::shared_ptr<const StopSignal> stop;
    Clock::time_point deadline;

    /// The same stop signal, and the earlier of both times.
    Until within(Clock::duration time) const { return {stop, std::min(deadline, Clock::now() + time)}; }
};

enum class Wait { ready, timeout, stopped };

/// Waits until the descriptor can be read; a negative descriptor only waits. *Any* thread.
Wait waitReadable(int descriptor, const Until& until);

/// The error for a wait that did not end with `ready`; `what` names what was waited for.
Error waitFailure(Wait wait, const std::string& what);

}  // namespace wp
