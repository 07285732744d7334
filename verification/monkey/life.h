#pragma once

#include <cstdint>

#include "verification/monkey/watched_screen.h"

namespace wp::monkey {

/// Plays one run of the diagnostic with so many random events at most, on queues that take one step at a time
/// in a random order, on the screen that is made for it: the same seed plays the very same life again. Returns the
/// events played; throws `Broken`.
int playSteppedLife(std::uint64_t seed, int events, const ScreenMaker& makeScreen);

/// A stepped life on the television's screen with motion, on no display, in a process of its own: the toolkit bears one
/// application in a process. How far a fade has come when the next event plays is the machine's.
int playTelevisionLife(std::uint64_t seed, int events);

/// A life with real threads and real delays. The seed gives the same events; how the threads meet is the
/// machine's.
int playThreadedLife(std::uint64_t seed, int events);

}  // namespace wp::monkey
