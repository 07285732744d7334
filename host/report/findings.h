#pragma once

#include "host/report/causes.h"
#include "host/report/report.h"

namespace wp::host {

/// Everything that the parts of a report are made from.
struct ReportInput {
    const Evidence& evidence;
    const Thresholds& thresholds;
    const Texts& texts;
    const Checks& checks;
    const std::vector<Cause>& causes;
};

/// All findings, the worst first: the causes, with what follows from them, and the findings that no cause
/// explains. A finding of the joined and of the selected network is told once.
std::vector<ReportedFinding> findingsOf(const ReportInput& input);

/// The tests that could not tell, by reason, without those that a cause explains.
std::vector<Untold> untoldOf(const ReportInput& input);

/// Whether somebody gave this answer; a replay says so where its recording has none.
bool isRecorded(const Answer& answer);

/// Why the test could not tell, in a sentence.
std::string reasonText(const Check& check, bool hasAnswers, const Texts& texts);

}  // namespace wp::host
