#pragma once

#include <vector>

#include "host/report/evidence.h"

namespace wp::host {

/// One test of one part, as far as it was made.
struct Check {
    const CatalogueEntry* test = nullptr;
    Part part = Part::device;
    std::optional<bool> verdict;
    const Answer* answer = nullptr;  ///< null: the evidence has none

    bool isFinding() const;
    /// Whether the test was made and could not tell.
    bool isUntold() const;
};

/// All tests of the parts that were tested, in the order of the catalogue; device, joined, selected.
class Checks {
  public:
    /// The evidence must outlive the checks.
    explicit Checks(const Evidence& evidence);

    const std::vector<Check>& all() const { return all_; }
    bool yes(int testID, Part part = Part::joined) const { return is(true, testID, part); }
    bool no(int testID, Part part = Part::joined) const { return is(false, testID, part); }
    const Check* find(int testID, Part part = Part::joined) const;

  private:
    bool is(bool verdict, int testID, Part part) const;

    std::vector<Check> all_;
};

}  // namespace wp::host
