#pragma once

#include <poll.h>

#include <span>

#include "linux/stop_signal.h"

namespace wp {

/// Waits until one of the descriptors has an event that its entry asks for, which `poll` leaves in the entry.
/// Being stopped counts before an event, an event before the deadline. *Any* thread.
Wait waitAny(std::span<pollfd> descriptors, const Until& until);

/// What is left until the deadline, rounded up to whole milliseconds; 0 once it has passed.
std::chrono::milliseconds timeLeft(const Until& until);

}  // namespace wp
