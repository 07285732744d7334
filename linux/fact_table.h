#pragma once

#include <functional>
#include <span>

#include "linux/phase.h"

namespace wp {

/// Puts what was gathered into its place. Owner's thread.
using Store = std::function<void(Facts& facts)>;

/// How one fact is had.
struct FactRow {
    Fact fact;
    std::span<const Fact> needs;  ///< facts that it builds on
    std::span<const Fact> after;  ///< facts that it must not disturb: it waits while they are being gathered
    std::chrono::milliseconds most;  ///< how long it may take
    /// On a worker's thread; reads only the facts that it needs.
    Store (*gather)(const Facts& facts, const PhaseTopic& topic, Sources& sources, const Until& until);
};

/// The row of a fact. *Any* thread.
const FactRow& rowOf(Fact fact);

}  // namespace wp
