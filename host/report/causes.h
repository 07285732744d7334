#pragma once

#include <span>
#include <vector>

#include "host/report/checks.h"

namespace wp::host {

/// What several tests show together, told as one finding.
struct Cause {
    const char* texts;  ///< prefix of the keys of its FOUND, MEANS and DO
    const char* whole;  ///< key of its sentence on the whole; null: it does not stop the network
    int testID;         ///< the test that leads it, 0 where none does
    Part part;
    Severity severity;
    Doer doer;
    std::vector<int> follow;  ///< tests of the part that are explained by it
};

/// The causes that the checks show, what stops the network first. At most one of them says why nothing
/// works. *Any*.
std::vector<Cause> causesOf(const Evidence& evidence, const Checks& checks);

}  // namespace wp::host
