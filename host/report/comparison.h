#pragma once

#include <string>
#include <vector>

#include "host/report/evidence.h"
#include "host/report/texts.h"

namespace wp::host {

/// What became of one test's finding since an earlier run.
struct ReportedChange {
    enum class Kind {
        appeared,  ///< a finding now, none before
        gone,      ///< a finding before, none now
        value,     ///< a finding both times, with another value
    };

    Kind kind = Kind::appeared;
    Part part = Part::device;
    int testID = 0;
    std::string what;         ///< one sentence: what happened to which finding
    std::string where;        ///< the part in words
    std::string before, now;  ///< the values measured; empty where nothing was
};

/// What changed since an earlier run, as finished sentences of one language.
struct Comparison {
    /// What the comparison rests on, a sentence each: another network than before, a part that is no longer
    /// tested, tests that could tell before and cannot now.
    std::vector<std::string> notes;
    std::vector<ReportedChange> changes;  ///< by kind, then in the order of the run
};

/// Compares the findings of two runs, the earlier one first. What only one of them could tell has not changed as
/// far as anybody knows. *Any*.
Comparison compared(const Evidence& earlier, const Evidence& evidence, const Texts& texts);

}  // namespace wp::host
