#pragma once

#include <optional>
#include <span>
#include <string>

namespace wp::host {

/// What a test looks at: this device, the joined network alone, the joined and the selected network, or the
/// scan that fills the list of networks.
enum class TestScope { device, joined, joinedAndSelected, list };

/// Which value of the result key is a finding that deserves attention.
enum class FoundWhen { isTrue, isFalse, never };

/// How much a finding matters, the most severe first.
enum class Severity {
    broken,   ///< the network cannot be used
    problem,  ///< it is slow, breaks off, or is unsafe
    advice,   ///< it could be better
    notice,   ///< worth knowing; nothing needs to be done
};

/// Who can do something about a finding.
enum class Doer { viewer, routerOwner, provider, deviceMaker, nobody };

/// One numbered test. Its words are in the string tables of the report, under `testKey`.
struct CatalogueEntry {
    int testID;
    TestScope scope;
    const char* resultKey;  ///< in the section of the result document that the scope names
    FoundWhen foundWhen;
    Severity severity;  ///< of the finding when nothing else tells more
    Doer doer;
    const char* valueKey;  ///< the value measured, in the same section; null: none
    const char* name;      ///< for the progress line and the log
};

/// All tests in the order in which a run performs them; the list's own test last.
std::span<const CatalogueEntry> catalogue();

/// The entry of that test; null for a number that no test has.
const CatalogueEntry* catalogueEntry(int testID);

/// The key of one of the test's texts, for example "T14_ASKS".
std::string testKey(int testID, const char* what);

}  // namespace wp::host
