#include "host/report/report.h"

#include <algorithm>

#include "host/report/facts.h"
#include "host/report/findings.h"
#include "host/report/measured.h"
#include "platform/ui/display_text.h"

namespace wp::host {
namespace {

constexpr std::size_t kClosingFindings = 3;

std::size_t countOf(const std::vector<ReportedFinding>& findings, Severity severity, bool ofSelectedAlone) {
    return static_cast<std::size_t>(std::ranges::count_if(findings, [&](const ReportedFinding& finding) {
        bool isSelectedAlone = finding.parts == std::vector{Part::selected};
        return finding.severity == severity && isSelectedAlone == ofSelectedAlone;
    }));
}

/// The text for one or for many.
std::string counted(const std::string& key, std::size_t count, TextValues values, const Texts& texts) {
    values.emplace_back("count", std::to_string(count));
    return texts.text(key + (count == 1 ? "_ONE" : "_MANY"), values);
}

/// The sentence on the whole where nothing stops the network.
std::string wholeWithoutOutage(const ReportInput& input, const std::vector<ReportedFinding>& findings) {
    const Texts& texts = input.texts;
    TextValues names = {{"network", networkText(input.evidence.joinedName, texts)},
                        {"selected", networkText(input.evidence.selectedName, texts)}};
    std::size_t problems =
        countOf(findings, Severity::broken, false) + countOf(findings, Severity::problem, false);
    std::size_t advice = countOf(findings, Severity::advice, false);
    std::size_t ofSelected = countOf(findings, Severity::problem, true);
    bool works = input.checks.yes(6) || input.checks.yes(9) || input.checks.yes(11);
    bool isOptedOut = input.evidence.statusCode == -6 || input.evidence.statusCode == -7;
    if (isOptedOut && !wasTested(input.evidence, Part::joined)) return texts.text("WHOLE_OPTED_OUT");
    if (!works) {
        std::size_t all = problems + advice;
        return all == 0 ? texts.text("WHOLE_UNKNOWN", names) : counted("WHOLE_UNKNOWN", all, names, texts);
    }
    if (problems > 0) return counted("WHOLE_PROBLEMS", problems, names, texts);
    if (ofSelected > 0) return counted("WHOLE_SELECTED", ofSelected, names, texts);
    if (advice > 0) return counted("WHOLE_ADVICE", advice, names, texts);
    return texts.text(input.evidence.hasAnswers ? "WHOLE_FINE" : "WHOLE_FINE_RESULT", names);
}

std::string wholeText(const ReportInput& input, const std::vector<ReportedFinding>& findings) {
    for (const Cause& cause : input.causes)
        if (cause.whole)
            return input.texts.text(cause.whole,
                                    {{"network", networkText(input.evidence.joinedName, input.texts)}});
    return wholeWithoutOutage(input, findings);
}

std::string unknownText(const ReportInput& input, const Check& check) {
    if (!check.answer || !check.answer->error) return input.texts.text("ANSWER_UNKNOWN");
    return input.texts.text("ANSWER_UNKNOWN_WHY",
                            {{"reason", reasonText(check, input.evidence.hasAnswers, input.texts)}});
}

std::string serviceWords(const Check& check) {
    const bool hasWords = check.answer && check.answer->error && isRecorded(*check.answer);
    return hasWords ? ui::displayForm(check.answer->error->message) : "";
}

ReportedTest testOf(const ReportInput& input, const Check& check) {
    const Texts& texts = input.texts;
    ReportedTest test;
    test.part = check.part;
    test.testID = check.test->testID;
    test.resultKey = check.test->resultKey;
    test.question = texts.text(testKey(test.testID, "ASKS"));
    // The list's test is named for what it does not find, its question for what it does.
    if (check.verdict) test.answer = texts.text(*check.verdict ? "ANSWER_YES" : "ANSWER_NO");
    if (check.verdict) test.measured = measuredText(input.evidence, check, texts);
    if (check.isUntold()) {
        test.answer = unknownText(input, check);
        test.detail = serviceWords(check);
    }
    if (test.answer.empty()) test.answer = texts.text("ANSWER_NOT_ASKED");
    return test;
}

}  // namespace

std::string partText(const Evidence& evidence, Part part, const Texts& texts) {
    switch (part) {
        case Part::device:
            return texts.text("PART_DEVICE");
        case Part::joined:
            return texts.text("PART_JOINED", {{"network", networkText(evidence.joinedName, texts)}});
        case Part::selected:
            break;
    }
    return texts.text("PART_SELECTED", {{"network", networkText(evidence.selectedName, texts)}});
}

std::string severityText(Severity severity, const Texts& texts) {
    constexpr const char* kKeys[] = {"SEVERITY_BROKEN", "SEVERITY_PROBLEM", "SEVERITY_ADVICE",
                                     "SEVERITY_NOTICE"};
    return texts.text(kKeys[static_cast<std::size_t>(severity)]);
}

std::string doerText(Doer doer, const Texts& texts) {
    constexpr const char* kKeys[] = {"DOER_VIEWER", "DOER_ROUTER_OWNER", "DOER_PROVIDER", "DOER_DEVICE_MAKER",
                                     "DOER_NOBODY"};
    return texts.text(kKeys[static_cast<std::size_t>(doer)]);
}

Report makeReport(const Evidence& evidence, const Thresholds& thresholds, const Texts& texts) {
    Checks checks(evidence);
    const Thresholds applied = thresholdsOf(evidence, thresholds);
    std::vector<Cause> causes = causesOf(evidence, checks);
    ReportInput input{evidence, applied, texts, checks, causes};
    Report report;
    report.title = texts.text("TITLE");
    report.findings = findingsOf(input);
    // Sorted: what is only worth knowing comes last.
    auto remarks = std::ranges::find(report.findings, Severity::notice, &ReportedFinding::severity);
    report.facts = factsOf(input, {remarks, report.findings.end()});
    report.findings.erase(remarks, report.findings.end());
    report.summary = wholeText(input, report.findings);
    report.untold = untoldOf(input);
    for (const Check& check : checks.all()) report.tests.push_back(testOf(input, check));
    if (wasTested(evidence, Part::joined)) report.joinedName = networkText(evidence.joinedName, texts);
    if (wasTested(evidence, Part::selected)) report.selectedName = networkText(evidence.selectedName, texts);
    return report;
}

ClosingSummary closingSummary(const Report& report) {
    ClosingSummary closing{report.summary, {}};
    for (const ReportedFinding& finding : report.findings) {
        if (closing.findings.size() == kClosingFindings) break;
        closing.findings.push_back(finding);
    }
    return closing;
}

}  // namespace wp::host
