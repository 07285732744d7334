#pragma once

#include <span>

#include "service/details.h"
#include "service/facts.h"
#include "service/outcome.h"

namespace wp {

/// What a test asks about.
enum class Subject {
    device,   ///< this device's own configuration; a network's name in the request plays no part
    joined,   ///< the joined network, whatever the request names
    network,  ///< the network that the request names, else the joined one
    scan,     ///< the list of networks, always from a new scan
};

/// One numbered test: the facts that it goes by, and its verdict.
struct NumberedTest {
    int number;
    Subject subject;
    std::span<const Fact> needs;
    Outcome (*verdict)(const Facts& facts);  ///< null while the test is not measured yet
    Details (*details)(const Facts& facts);  ///< what was measured beyond it; never null
};

/// All tests, ordered by number. *Any* thread.
std::span<const NumberedTest> numberedTests();

/// The test of this number, null where there is none.
const NumberedTest* findTest(int number);

/// The test's verdict, or an error that says that it is not measured yet. *Any* thread.
Outcome judge(const NumberedTest& test, const Facts& facts);

}  // namespace wp
