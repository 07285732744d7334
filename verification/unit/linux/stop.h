#pragma once

#include <chrono>
#include <memory>

#include "linux/stop_signal.h"

namespace wp {

/// A wait of a test's own: long enough that only being stopped or answered ends it.
inline Until patience(std::chrono::milliseconds time = std::chrono::seconds(20),
                      std::shared_ptr<const StopSignal> stop = std::make_shared<StopSignal>()) {
    return {std::move(stop), Clock::now() + time};
}

}  // namespace wp
