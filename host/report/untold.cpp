#include <algorithm>
#include <map>

#include "host/report/findings.h"

namespace wp::host {
namespace {

/// The service's codes of errors, and those that stand for what a report itself lacks.
constexpr const char* kReasons[] = {
    "NOT_STATED",    "NO_INTERFACE", "NOT_JOINED", "NOT_FOUND",     "UNAVAILABLE", "UNSUPPORTED",
    "NOT_PERMITTED", "TIMEOUT",      "CANCELLED",  "CONFIGURATION", "MALFORMED",
};
constexpr int kNoRecordedAnswer = -1, kNotFound = 3;

/// A network that is not joined shows no sign-in page: nothing went wrong.
bool isToldOnceJoined(const Check& check) {
    bool isUnknown = !check.answer || (check.answer->error && check.answer->error->code == kNotFound);
    return check.part == Part::selected && check.test->testID == 46 && isUnknown;
}

std::string reasonKey(const Check& check, bool hasAnswers) {
    if (isToldOnceJoined(check)) return "AFTER_JOINING";
    if (!check.answer) return hasAnswers ? "NOT_RECORDED" : "NOT_STATED";
    if (!isRecorded(*check.answer)) return "NOT_RECORDED";
    int code = check.answer->error ? check.answer->error->code : 0;
    bool isKnown = code > 0 && code < static_cast<int>(std::size(kReasons));
    return isKnown ? kReasons[code] : "OTHER";
}

bool isExplained(const std::vector<Cause>& causes, const Check& check) {
    return std::ranges::any_of(causes, [&](const Cause& cause) {
        bool follows = std::ranges::find(cause.follow, check.test->testID) != cause.follow.end();
        return cause.part == check.part && (follows || cause.testID == check.test->testID);
    });
}

/// A result alone does not tell some of what makes a network fail.
bool seemsFineByResult(const ReportInput& input) {
    bool isOut = std::ranges::any_of(input.causes, [](const Cause& cause) { return cause.whole != nullptr; });
    return !isOut && !input.evidence.hasAnswers && wasTested(input.evidence, Part::joined);
}

Untold optedOut(const char* key, const Texts& texts) {
    return {texts.text(key), texts.text("REMEDY_OPTED_OUT"), {}};
}

}  // namespace

bool isRecorded(const Answer& answer) {
    return !answer.error || answer.error->code != kNoRecordedAnswer;
}

std::string reasonText(const Check& check, bool hasAnswers, const Texts& texts) {
    return texts.text("REASON_" + reasonKey(check, hasAnswers));
}

std::vector<Untold> untoldOf(const ReportInput& input) {
    const Texts& texts = input.texts;
    std::vector<Untold> all;
    if (input.evidence.statusCode == -6) all.push_back(optedOut("OPTED_OUT_JOINED", texts));
    if (input.evidence.statusCode == -7) all.push_back(optedOut("OPTED_OUT_SELECTED", texts));
    std::map<std::string, std::size_t> places;
    for (const Check& check : input.checks.all()) {
        if (!check.isUntold() || isExplained(input.causes, check)) continue;
        std::string key = reasonKey(check, input.evidence.hasAnswers);
        auto [place, isNew] = places.emplace(key, all.size());
        if (isNew) all.push_back({texts.text("REASON_" + key), texts.text("REMEDY_" + key), {}});
        std::vector<std::string>& tests = all[place->second].tests;
        std::string name = texts.text(testKey(check.test->testID, "NAME"));
        if (check.part == Part::selected) name += texts.aside(partText(input.evidence, check.part, texts));
        tests.push_back(std::move(name));
    }
    if (seemsFineByResult(input))
        all.push_back({texts.text("REASON_RESULT_ALONE"), texts.text("REMEDY_RESULT_ALONE"), {}});
    return all;
}

}  // namespace wp::host
