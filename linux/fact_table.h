#pragma once

#include <functional>
#include <span>

#include "linux/phase.h"

namespace wp {

/// Puts what was gathered into its place. Owner's thread.
using Store = std::function<void(Facts& facts)>;

/// What a worker goes by.
struct Gathering {
    const Facts& facts;  ///< only those that the row needs may be read
    const PhaseTopic& topic;
    std::int64_t startOfPhase;  ///< ms on the clock that counts suspended time too
    Sources& sources;
    Until until;
    const char* loss;                   ///< of the row
    HomeChannel::Stay* stay = nullptr;  ///< of a fact that needs the home channel, and null for the others
};

/// What becomes of the channel that the radio is joined on while a fact is gathered.
enum class HomeUse {
    none,  ///< it does not matter
    needed,  ///< from when the fact is wanted until it is there, or its gathering says that it is not needed any more
    neededAtFirst,  ///< the same, but for a second at most: what takes longer is not told by a tenth of a second
    left,           ///< the radio visits other channels
};

/// How one fact is had.
struct FactRow {
    Fact fact;
    const char* name;             ///< in a trace
    std::span<const Fact> needs;  ///< facts that it builds on
    std::span<const Fact> after;  ///< facts that may spare it its work: it waits until each is there
    HomeUse home;
    std::chrono::milliseconds most;               ///< how long it may take
    Store (*gather)(const Gathering& gathering);  ///< on a worker's thread
    const char* loss;                             ///< what nobody can tell without it
};

/// All rows, in the order in which they are begun where several can be. *Any* thread.
std::span<const FactRow> factRows();
/// The row of a fact. *Any* thread.
const FactRow& rowOf(Fact fact);

}  // namespace wp
