#pragma once

#include <optional>
#include <string>
#include <vector>

#include "host/report/comparison.h"
#include "host/report/evidence.h"
#include "host/report/limits.h"
#include "host/report/texts.h"

namespace wp::host {

// A report as data: finished sentences of one language, without layout. Names and other texts from the air are
// in their display form (`platform/ui/display_text.h`), safe for a terminal; HTML escapes what it shows.

/// Something that deserves attention. Texts that do not apply are empty.
struct ReportedFinding {
    int testID = 0;           ///< the test that leads it; 0 where none does
    std::vector<Part> parts;  ///< what it is about
    Severity severity = Severity::notice;
    Doer doer = Doer::nobody;
    std::string where;                 ///< the parts in words
    std::string what;                  ///< one sentence
    std::string measured;              ///< value with unit
    std::string threshold;             ///< what counts as a finding
    std::string source;                ///< where the threshold comes from
    std::string means;                 ///< what it does
    std::string advice;                ///< what to do about it
    std::string by;                    ///< by whom
    std::vector<std::string> follows;  ///< findings that this one explains, a sentence each
};

/// Tests that could not tell, for one reason.
struct Untold {
    std::string reason;
    std::string remedy;
    std::vector<std::string> tests;
};

/// Something worth knowing that is no finding.
struct ReportedFact {
    Part part = Part::joined;
    std::string label;
    std::string value;
};

/// One test, for those who want to see all.
struct ReportedTest {
    Part part = Part::device;
    int testID = 0;
    const char* resultKey = nullptr;
    std::string question;
    std::string answer;  ///< yes, no, or that it could not be told and why
    std::string measured;
    std::string detail;  ///< the service's own words for why it could not be told: English, in display form
};

struct Report {
    std::string title;
    std::string summary;                   ///< one sentence on the whole
    std::optional<Comparison> comparison;  ///< what changed; absent: no earlier run was given
    std::vector<ReportedFinding>
        findings;  ///< the worst first; what is only worth knowing is among the facts
    std::vector<Untold> untold;
    std::vector<ReportedFact> facts;
    std::vector<ReportedTest> tests;  ///< in the order of the run
    /// The networks in words, "" where there is none.
    std::string joinedName, selectedName;
};

/// Makes a report. The same evidence gives the same report. *Any*.
Report makeReport(const Evidence& evidence, const Thresholds& thresholds, const Texts& texts);

/// For the last screen of a run: the sentence on the whole and the first of the findings, three at most. *Any*.
struct ClosingSummary {
    std::string summary;
    std::vector<ReportedFinding> findings;
};
ClosingSummary closingSummary(const Report& report);

/// A part in words: "This device", "Network “Home”". *Any*.
std::string partText(const Evidence& evidence, Part part, const Texts& texts);
/// A severity, or whoever can do something, in words. *Any*.
std::string severityText(Severity severity, const Texts& texts);
std::string doerText(Doer doer, const Texts& texts);

}  // namespace wp::host
