#pragma once

#include <optional>
#include <span>
#include <string>

namespace wp::host {

/// What a test looks at: this device, the joined network alone, the joined and the selected network, or the
/// scan that fills the list of networks.
enum class TestScope { device, joined, joinedAndSelected, list };

/// Which value of the result key is a finding that deserves attention.
enum class Finding { whenTrue, whenFalse, never };

/// One numbered test in the words of the person who reads about it.
struct CatalogueEntry {
    int testID;
    TestScope scope;
    const char* resultKey;  ///< in the section of the result document that the scope names
    Finding finding;
    const char* name;     ///< for the progress line
    const char* asks;     ///< the question that the test answers
    const char* because;  ///< what counts as a finding
};

/// All tests in the order in which a run performs them; the list's own test last.
std::span<const CatalogueEntry> catalogue();

/// The entry of that test; null for a number that no test has.
const CatalogueEntry* catalogueEntry(int testID);

/// What `wifi-profile tests` prints.
std::string catalogueText();

}  // namespace wp::host
