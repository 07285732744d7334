#include "host/report/evidence.h"

#include "exchange/object_reader.h"

namespace wp::host {
namespace {

std::optional<std::string> nameIn(const DictionaryPointer& section) {
    if (std::optional<std::string> name = textIn(section, "networkName")) return name;
    return textIn(dictionaryIn(section, "preferredNetwork"), "SSID");
}

DictionaryPointer sectionIn(const DictionaryPointer& data, std::string_view key) {
    DictionaryPointer section = dictionaryIn(data, key);
    return section ? section : Dictionary::make();
}

bool isAbout(const Answer& answer, const CatalogueEntry& test, Part part) {
    if (answer.testID != test.testID) return false;
    return part == Part::selected ? answer.networkName.has_value() : !answer.networkName;
}

}  // namespace

Answer answerFrom(int testID, std::optional<std::string> networkName,
                  const DiagnosticsTestResponse& response) {
    Answer answer;
    answer.testID = testID;
    answer.networkName = std::move(networkName);
    if (response.error && response.error->code != 0) answer.error = response.error;
    if (!response.results || response.results->empty() || !response.results->front()) return answer;
    // Beside an error there may be details, but no verdict.
    if (!answer.error) answer.result = response.results->front()->result;
    answer.info = response.results->front()->info;
    return answer;
}

Evidence evidenceFrom(std::int64_t statusCode, const DictionaryPointer& data) {
    Evidence evidence;
    evidence.statusCode = statusCode;
    evidence.device = sectionIn(data, "device");
    evidence.joined = sectionIn(data, "currentNetwork");
    evidence.selected = sectionIn(data, "selectedNetwork");
    evidence.joinedName = nameIn(evidence.joined);
    evidence.selectedName = nameIn(evidence.selected);
    return evidence;
}

Evidence evidenceFrom(std::int64_t statusCode, const DictionaryPointer& data, std::vector<Answer> answers) {
    Evidence evidence = evidenceFrom(statusCode, data);
    evidence.hasAnswers = true;
    evidence.answers = std::move(answers);
    for (const Answer& answer : evidence.answers)
        if (answer.networkName) evidence.selectedName = answer.networkName;
    return evidence;
}

Evidence evidenceFromResult(const Value& json) {
    Place top;
    ObjectReader reader(json, top);
    std::int64_t statusCode =
        readInteger(reader.need("statusCode"), Place(top, "statusCode"), INT64_MIN, INT64_MAX);
    Place place(top, "data");
    const DictionaryPointer* data = reader.need("data").as<DictionaryPointer>();
    if (!data) place.refuse("must be an object");
    for (const char* section : {"device", "currentNetwork", "selectedNetwork"})
        if (!dictionaryIn(*data, section)) Place(place, section).refuse("must be an object");
    reader.finish();
    return evidenceFrom(statusCode, *data);
}

const DictionaryPointer& sectionOf(const Evidence& evidence, Part part) {
    if (part == Part::device) return evidence.device;
    return part == Part::joined ? evidence.joined : evidence.selected;
}

bool concerns(const CatalogueEntry& test, Part part) {
    switch (test.scope) {
        case TestScope::device:
            return part == Part::device;
        case TestScope::joinedAndSelected:
            return part != Part::device;
        case TestScope::joined:
        case TestScope::list:
            break;
    }
    return part == Part::joined;
}

const Answer* answerTo(const Evidence& evidence, Part part, int testID) {
    const CatalogueEntry* test = catalogueEntry(testID);
    if (!test || !concerns(*test, part)) return nullptr;
    for (auto answer = evidence.answers.rbegin(); answer != evidence.answers.rend(); ++answer)
        if (isAbout(*answer, *test, part)) return &*answer;
    return nullptr;
}

std::optional<bool> verdictOf(const Evidence& evidence, Part part, const CatalogueEntry& test) {
    if (!concerns(test, part)) return std::nullopt;
    std::optional<Value> value = sectionOf(evidence, part)->value(test.resultKey);
    if (!value) return std::nullopt;
    if (const bool* flag = value->as<bool>()) return *flag;
    if (const std::int64_t* number = value->as<std::int64_t>()) return *number != 0;
    return std::nullopt;
}

bool wasTested(const Evidence& evidence, Part part) {
    for (const CatalogueEntry& test : catalogue()) {
        if (test.scope == TestScope::list || !concerns(test, part)) continue;
        if (verdictOf(evidence, part, test) || answerTo(evidence, part, test.testID)) return true;
    }
    return false;
}

DictionaryPointer detailsOf(const Evidence& evidence, Part part, int testID) {
    const Answer* answer = answerTo(evidence, part, testID);
    return answer && answer->info ? dictionaryIn(answer->info, "Details") : nullptr;
}

std::optional<double> numberIn(const DictionaryPointer& dictionary, std::string_view key) {
    std::optional<Value> value = dictionary ? dictionary->value(key) : std::nullopt;
    if (!value) return std::nullopt;
    if (const std::int64_t* number = value->as<std::int64_t>()) return static_cast<double>(*number);
    if (const std::uint64_t* number = value->as<std::uint64_t>()) return static_cast<double>(*number);
    if (const double* number = value->as<double>()) return *number;
    return std::nullopt;
}

std::optional<std::string> textIn(const DictionaryPointer& dictionary, std::string_view key) {
    std::optional<Value> value = dictionary ? dictionary->value(key) : std::nullopt;
    const std::string* text = value ? value->as<std::string>() : nullptr;
    return text ? std::optional(*text) : std::nullopt;
}

std::optional<bool> flagIn(const DictionaryPointer& dictionary, std::string_view key) {
    std::optional<Value> value = dictionary ? dictionary->value(key) : std::nullopt;
    const bool* flag = value ? value->as<bool>() : nullptr;
    return flag ? std::optional(*flag) : std::nullopt;
}

DictionaryPointer dictionaryIn(const DictionaryPointer& dictionary, std::string_view key) {
    std::optional<Value> value = dictionary ? dictionary->value(key) : std::nullopt;
    const DictionaryPointer* found = value ? value->as<DictionaryPointer>() : nullptr;
    return found ? *found : nullptr;
}

}  // namespace wp::host
