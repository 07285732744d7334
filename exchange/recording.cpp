#include "exchange/recording.h"

#include <limits>

#include "exchange/object_reader.h"
#include "exchange/whole_file.h"
#include "platform/json_writer.h"

namespace wp {
namespace {

using Entries = Dictionary::Entries;
using std::chrono::milliseconds;

constexpr const char* kFormat = "wifi-profile-recording";
constexpr std::int64_t kVersion = 1;
/// The longest delay, 24 days: it fits every clock's arithmetic.
constexpr std::int64_t kLongestDelay = std::numeric_limits<std::int32_t>::max();

milliseconds readDelay(const Value& json, const Place& place) {
    return milliseconds(readInteger(json, place, 0, kLongestDelay));
}

/// Reads the array under the key, element by element; nothing where the key is absent.
template <class Element>
std::vector<Element> readList(ObjectReader& reader, std::string_view key,
                              Element (*readElement)(const Value&, const Place&)) {
    std::vector<Element> list;
    const Value* json = reader.find(key);
    if (!json) return list;
    Place place(reader.place(), key);
    ArrayPointer elements = readArray(*json, place);
    list.reserve(elements->size());
    for (std::size_t i = 0; i < elements->size(); ++i)
        list.push_back(readElement((*elements)[i], Place(place, i)));
    return list;
}

RecordedAnswer readAnswer(const Value& json, const Place& place) {
    ObjectReader reader(json, place);
    RecordedAnswer answer;
    constexpr int most = std::numeric_limits<int>::max();
    answer.test = static_cast<int>(readInteger(reader.need("test"), Place(place, "test"), 0, most));
    if (const Value* name = reader.find("networkName"))
        answer.networkName = readText(*name, Place(place, "networkName"));
    if (const Value* age = reader.find("maxScanCacheAge")) {
        readNumber(*age, Place(place, "maxScanCacheAge"));
        answer.maxScanCacheAge = *age;
    }
    answer.response = decodeResponse(reader);
    if (const Value* delay = reader.find("delayMs"))
        answer.delay = readDelay(*delay, Place(place, "delayMs"));
    reader.finish();
    return answer;
}

RecordedPowerEvent readEvent(const Value& json, const Place& place) {
    ObjectReader reader(json, place);
    RecordedPowerEvent event;
    event.after = readDelay(reader.need("afterMs"), Place(place, "afterMs"));
    event.power = readFlag(reader.need("power"), Place(place, "power"));
    reader.finish();
    return event;
}

/// Before anything else is looked at, so that a file of another kind or age is called that.
void checkFormat(ObjectReader& reader) {
    Place formatPlace(reader.place(), "format");
    if (readText(reader.need("format"), formatPlace) != kFormat)
        formatPlace.refuse("must be \"" + std::string(kFormat) + '"');
    Place versionPlace(reader.place(), "version");
    const Value& version = reader.need("version");
    if (version != Value(kVersion)) versionPlace.refuse("must be " + std::to_string(kVersion));
}

Recording decodeRecording(const Value& json) {
    Place top;
    ObjectReader reader(json, top);
    checkFormat(reader);
    Recording recording;
    if (const Value* text = reader.find("description"))
        recording.description = readText(*text, Place(top, "description"));
    if (const Value* capabilities = reader.find("capabilities"))
        recording.capabilities = readFlags(*capabilities, Place(top, "capabilities"));
    if (const Value* automation = reader.find("automation"))
        recording.automation = readFlag(*automation, Place(top, "automation"));
    if (const Value* wifi = reader.find("wifi")) recording.wifi = decodeWiFi(*wifi, Place(top, "wifi"));
    recording.status = readList(reader, "status", decodeStatus);
    recording.answers = readList(reader, "answers", readAnswer);
    recording.events = readList(reader, "events", readEvent);
    reader.finish();
    return recording;
}

Value encodeAnswer(const RecordedAnswer& answer) {
    Entries entries;
    encodeResponse(answer.response, entries);
    entries.emplace("test", answer.test);
    if (answer.networkName) entries.emplace("networkName", *answer.networkName);
    if (answer.maxScanCacheAge) entries.emplace("maxScanCacheAge", *answer.maxScanCacheAge);
    if (answer.delay.count() > 0) entries.emplace("delayMs", std::int64_t{answer.delay.count()});
    return Dictionary::make(std::move(entries));
}

Value encodeEvent(const RecordedPowerEvent& event) {
    return Dictionary::make({{"afterMs", std::int64_t{event.after.count()}}, {"power", event.power}});
}

}  // namespace

std::variant<Recording, Refusal> readRecording(std::string_view text) {
    auto json = readJSON(text);
    if (auto* refusal = std::get_if<Refusal>(&json)) return *refusal;
    try {
        return decodeRecording(std::get<Value>(json));
    } catch (const Refused& refused) {
        return refused.refusal();
    }
}

std::variant<Recording, Refusal> loadRecording(const std::string& path) {
    auto text = readWholeFile(path, JSONLimits().bytes);
    if (auto* refusal = std::get_if<Refusal>(&text)) return *refusal;
    return readRecording(std::get<std::string>(text));
}

std::string recordingText(const Recording& recording) {
    Entries entries{{"format", kFormat},
                    {"version", kVersion},
                    {"automation", recording.automation},
                    {"wifi", encodeWiFi(recording.wifi)}};
    if (!recording.description.empty()) entries.emplace("description", recording.description);
    Entries capabilities(recording.capabilities.begin(), recording.capabilities.end());
    entries.emplace("capabilities", Dictionary::make(std::move(capabilities)));
    Array status;
    for (const DiagnosticsStatusResponse& entry : recording.status) status.push_back(encodeStatus(entry));
    entries.emplace("status", std::move(status));
    Array answers;
    for (const RecordedAnswer& answer : recording.answers) answers.push_back(encodeAnswer(answer));
    entries.emplace("answers", std::move(answers));
    Array events;
    for (const RecordedPowerEvent& event : recording.events) events.push_back(encodeEvent(event));
    entries.emplace("events", std::move(events));
    return jsonText(Dictionary::make(std::move(entries)), JSONStyle::indented) + '\n';
}

}  // namespace wp
