#include "service/answer.h"

namespace wp {
namespace {

DictionaryPointer withDetails(const DictionaryPointer& info, Details details) {
    if (details.empty()) return info;
    Dictionary::Entries entries = info ? info->entries() : Dictionary::Entries();
    entries.emplace("Details", Dictionary::make(std::move(details)));
    return Dictionary::make(std::move(entries));
}

std::string_view wordOf(Reason reason) {
    switch (reason) {
        case Reason::noInterface:
            return "noInterface";
        case Reason::notJoined:
            return "notJoined";
        case Reason::notFound:
            return "notFound";
        case Reason::unavailable:
            return "unavailable";
        case Reason::unsupported:
            return "unsupported";
        case Reason::notPermitted:
            return "notPermitted";
        case Reason::timeout:
            return "timeout";
        case Reason::cancelled:
            return "cancelled";
        case Reason::badConfiguration:
            return "badConfiguration";
        case Reason::malformed:
            return "malformed";
    }
    return "unknown";
}

DiagnosticsTestResults oneResult(bool result, bool didPass, DictionaryPointer info) {
    return {std::make_shared<DiagnosticsTestResult>(DiagnosticsTestResult{result, didPass, std::move(info)})};
}

}  // namespace

DiagnosticsTestResponse answerOf(const NumberedTest& test, const Facts& facts) {
    const Outcome outcome = judge(test, facts);
    Details details = test.details(facts);
    if (outcome)
        return {oneResult(outcome->result, outcome->didPass, withDetails(outcome->info, std::move(details))),
                {}};
    DiagnosticsTestResponse response = answerOf(outcome.error());
    details.erase("Thresholds");  // none was applied
    if (details.empty()) return response;
    details.emplace("reason", wordOf(static_cast<Reason>(outcome.error().code)));
    response.results = oneResult(false, false, withDetails(nullptr, std::move(details)));
    return response;
}

DiagnosticsTestResponse answerOf(const Error& error) {
    return {std::nullopt, error};
}

}  // namespace wp
