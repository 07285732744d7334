#include "host/report/findings.h"

#include <algorithm>

#include "host/report/measured.h"

namespace wp::host {
namespace {

constexpr int kHighest2GHzChannel = 14;
constexpr std::size_t kMostNamed = 10;  // tests in one sentence

/// Of findings that are equally severe, those that people feel most come first.
constexpr int kFeltMost[] = {46, 31, 12, 3, 6, 7, 9, 11, 32, 24, 25, 26, 22, 39, 38, 40, 36, 37, 41};

bool explains(const Cause& cause, const Check& check) {
    if (cause.part != check.part) return false;
    return std::ranges::find(cause.follow, check.test->testID) != cause.follow.end();
}

bool leads(const Cause& cause, const Check& check) {
    return cause.part == check.part && cause.testID == check.test->testID;
}

bool isTaken(const std::vector<Cause>& causes, const Check& check) {
    return std::ranges::any_of(
        causes, [&](const Cause& cause) { return leads(cause, check) || explains(cause, check); });
}

/// What the leading test measured and the number that it was held against, where its verdict is the finding.
void addRule(const ReportInput& input, const Check& check, ReportedFinding& finding) {
    const Texts& texts = input.texts;
    int testID = check.test->testID;
    finding.measured = measuredText(input.evidence, check, texts);
    TextValues limits = limitsOf(testID, input.thresholds, texts);
    if (limits.empty()) return;
    finding.threshold = texts.text(testKey(testID, "RULE"), limits);
    finding.source = texts.text(testKey(testID, "SOURCE"));
}

/// For a crowded channel the advice names a quieter one of the same band, where one is known.
std::string adviceOf(const ReportInput& input, const Check& check) {
    const DictionaryPointer& section = sectionOf(input.evidence, check.part);
    std::optional<double> current = numberIn(section, "currentChannel");
    if (check.test->testID != 24 || !current) return "";
    std::optional<double> better =
        numberIn(section, *current <= kHighest2GHzChannel ? "2GHzChannel" : "5GHzChannel");
    if (!better) return "";
    if (better == current) return input.texts.text("T24_DO_NONE");
    return input.texts.text("T24_DO_CHANNEL", {{"channel", input.texts.number(*better, 0)}});
}

void addWords(const ReportInput& input, const std::string& prefix, ReportedFinding& finding) {
    finding.what = input.texts.text(prefix + "_FOUND");
    finding.means = input.texts.text(prefix + "_MEANS");
    finding.advice = input.texts.text(prefix + "_DO");
    finding.by = doerText(finding.doer, input.texts);
}

std::vector<std::string> followersOf(const ReportInput& input, const Cause& cause) {
    std::vector<std::string> found, untestable;
    for (const Check& check : input.checks.all()) {
        if (!explains(cause, check)) continue;
        if (check.isFinding()) found.push_back(input.texts.text(testKey(check.test->testID, "FOUND")));
        if (check.isUntold()) untestable.push_back(input.texts.text(testKey(check.test->testID, "NAME")));
    }
    // Where nearly nothing could be tested the cause says so itself, not test by test.
    if (!untestable.empty() && untestable.size() < cause.follow.size() && untestable.size() <= kMostNamed)
        found.push_back(input.texts.text("NOT_TESTABLE", {{"tests", input.texts.list(untestable)}}));
    return found;
}

ReportedFinding findingOf(const ReportInput& input, const Cause& cause) {
    ReportedFinding finding;
    finding.testID = cause.testID;
    finding.parts = {cause.part};
    finding.severity = cause.severity;
    finding.doer = cause.doer;
    addWords(input, cause.texts, finding);
    const Check* check = input.checks.find(cause.testID, cause.part);
    if (check && check->isFinding()) addRule(input, *check, finding);
    finding.follows = followersOf(input, cause);
    return finding;
}

ReportedFinding findingOf(const ReportInput& input, const Check& check) {
    ReportedFinding finding;
    finding.testID = check.test->testID;
    finding.parts = {check.part};
    finding.severity = check.test->severity;
    finding.doer = check.test->doer;
    addWords(input, "T" + std::to_string(finding.testID), finding);
    addRule(input, check, finding);
    if (std::string advice = adviceOf(input, check); !advice.empty()) finding.advice = advice;
    return finding;
}

/// Joins a finding of the selected network with the same one of the joined network.
bool isMerged(const ReportInput& input, const ReportedFinding& finding,
              std::vector<ReportedFinding>& findings) {
    for (ReportedFinding& earlier : findings) {
        bool isSame = earlier.testID == finding.testID && earlier.what == finding.what;
        if (!isSame || finding.parts != std::vector{Part::selected}) continue;
        if (earlier.measured != finding.measured) {
            auto told = [&](Part part, const std::string& value) {
                return partText(input.evidence, part, input.texts) + ": " + value;
            };
            earlier.measured =
                told(earlier.parts.front(), earlier.measured) + "; " + told(Part::selected, finding.measured);
        }
        earlier.severity = std::min(earlier.severity, finding.severity);
        earlier.parts.push_back(Part::selected);
        return true;
    }
    return false;
}

std::size_t feltRank(const ReportedFinding& finding) {
    return static_cast<std::size_t>(std::ranges::find(kFeltMost, finding.testID) - std::begin(kFeltMost));
}

int partRank(const ReportedFinding& finding) {
    if (finding.testID == 0) return -1;
    return finding.parts.front() == Part::device ? 2 : finding.parts.front() == Part::selected ? 1 : 0;
}

bool isWorse(const ReportedFinding& left, const ReportedFinding& right) {
    if (left.severity != right.severity) return left.severity < right.severity;
    if (partRank(left) != partRank(right)) return partRank(left) < partRank(right);
    return feltRank(left) < feltRank(right);
}

std::string whereText(const ReportInput& input, const ReportedFinding& finding) {
    std::vector<std::string> parts;
    for (Part part : finding.parts) parts.push_back(partText(input.evidence, part, input.texts));
    return input.texts.list(parts);
}

}  // namespace

std::vector<ReportedFinding> findingsOf(const ReportInput& input) {
    std::vector<ReportedFinding> findings;
    for (const Cause& cause : input.causes) findings.push_back(findingOf(input, cause));
    for (const Check& check : input.checks.all()) {
        if (!check.isFinding() || isTaken(input.causes, check)) continue;
        ReportedFinding finding = findingOf(input, check);
        if (!isMerged(input, finding, findings)) findings.push_back(std::move(finding));
    }
    for (ReportedFinding& finding : findings) finding.where = whereText(input, finding);
    std::ranges::stable_sort(findings, isWorse);
    return findings;
}

}  // namespace wp::host
