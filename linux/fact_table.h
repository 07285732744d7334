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
    const char* loss;  ///< of the row
    /// To be called where the fact no longer minds what is kept waiting for it (`FactRow::after`). *Any* thread.
    std::function<void()> yield = {};
};

/// How one fact is had.
struct FactRow {
    Fact fact;
    const char* name;             ///< in a trace
    std::span<const Fact> needs;  ///< facts that it builds on
    std::span<const Fact> after;  ///< facts that it must not disturb: it waits until each is there or yields
    std::chrono::milliseconds most;               ///< how long it may take
    Store (*gather)(const Gathering& gathering);  ///< on a worker's thread
    const char* loss;                             ///< what nobody can tell without it
};

/// The row of a fact. *Any* thread.
const FactRow& rowOf(Fact fact);

}  // namespace wp
