#pragma once

#include <cstdint>

namespace wp::monkey {

/// Plays one run of the diagnostic with so many random events at most, on queues that take one step at a time
/// in a random order: the same seed plays the very same life again. Returns the events played; throws
/// `Broken`.
int playSteppedLife(std::uint64_t seed, int events);

/// The same with real threads and real delays. The seed gives the same events; how the threads meet is the
/// machine's.
int playThreadedLife(std::uint64_t seed, int events);

}  // namespace wp::monkey
