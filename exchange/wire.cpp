#include "exchange/wire.h"

#include <limits>

#include "exchange/object_reader.h"
#include "platform/json_writer.h"

namespace wp {
namespace {

using Entries = Dictionary::Entries;
using Kind = WireRequest::Kind;

struct KindName {
    Kind kind;
    std::string_view name;
};
constexpr KindName kKindNames[] = {{Kind::test, "test"},
                                   {Kind::status, "status"},
                                   {Kind::wifi, "wifi"},
                                   {Kind::setPower, "setPower"},
                                   {Kind::cancel, "cancel"}};

std::string line(Entries entries) {
    return jsonText(Dictionary::make(std::move(entries)), JSONStyle::compact) + '\n';
}

std::string answerLine(std::uint64_t id, Entries entries) {
    entries.insert_or_assign("id", id);
    return line(std::move(entries));
}

Kind readKind(const Value& json, const Place& place) {
    std::string name = readText(json, place);
    for (const KindName& row : kKindNames)
        if (row.name == name) return row.kind;
    place.refuse("no such request");
}

std::uint64_t readID(ObjectReader& reader) {
    constexpr auto most = std::numeric_limits<std::int64_t>::max();
    Place place(reader.place(), "id");
    return static_cast<std::uint64_t>(readInteger(reader.need("id"), place, 0, most));
}

DictionaryPointer readConfiguration(const Value* json, const Place& place) {
    if (!json) return nullptr;
    if (const auto* configuration = json->as<DictionaryPointer>()) return *configuration;
    place.refuse("must be an object");
}

WireRequest decodeRequest(const Value& json) {
    Place top;
    ObjectReader reader(json, top);
    WireRequest request;
    request.kind = readKind(reader.need("request"), Place(top, "request"));
    if (request.kind != Kind::cancel) request.id = readID(reader);
    if (request.kind == Kind::test) {
        constexpr int most = std::numeric_limits<int>::max();
        request.test = static_cast<int>(readInteger(reader.need("test"), Place(top, "test"), 0, most));
        request.configuration = readConfiguration(reader.find("configuration"), Place(top, "configuration"));
    }
    if (request.kind == Kind::setPower) request.power = readFlag(reader.need("power"), Place(top, "power"));
    reader.finish();
    return request;
}

Greeting decodeGreeting(const Value& json) {
    Place top;
    ObjectReader reader(json, top);
    Greeting greeting;
    greeting.configuration = readConfiguration(reader.find("configuration"), Place(top, "configuration"));
    if (!greeting.configuration) greeting.refused = readText(reader.need("refused"), Place(top, "refused"));
    reader.finish();
    return greeting;
}

WireMessage decodeMessage(const Value& json) {
    Place top;
    ObjectReader reader(json, top);
    if (const Value* note = reader.find("note")) {
        Note message{readText(*note, Place(top, "note"))};
        reader.finish();
        return message;
    }
    if (const Value* event = reader.find("event")) {
        Place place(top, "event");
        ObjectReader eventReader(*event, place);
        PowerEvent message{readFlag(eventReader.need("power"), Place(place, "power"))};
        eventReader.finish();
        reader.finish();
        return message;
    }
    return WireAnswer{readID(reader), json};
}

/// Reads one line and refuses what `decode` refuses.
template <class Result>
Result readLine(std::string_view text, Result (*decode)(const Value&)) {
    auto json = readJSON(text, {.bytes = kLongestLine});
    if (auto* refusal = std::get_if<Refusal>(&json)) return *refusal;
    try {
        return decode(std::get<Value>(json));
    } catch (const Refused& refused) {
        return refused.refusal();
    }
}

std::optional<Error> takeError(ObjectReader& reader) {
    const Value* error = reader.find("error");
    if (!error) return std::nullopt;
    return decodeError(*error, Place(reader.place(), "error"));
}

/// What `read` makes of an answer; a key beside the number that it does not ask for is refused.
template <class Read>
auto readAnswer(const WireAnswer& answer, Read read) {
    const Place top;
    ObjectReader reader(answer.json, top);
    reader.find("id");
    auto response = read(reader);
    reader.finish();
    return response;
}

}  // namespace

Error cancelledError() {
    return {kCancelledCode, "cancelled"};
}

std::string greetingLine(const Greeting& greeting) {
    if (!greeting.configuration) return line({{"refused", greeting.refused}});
    return line({{"configuration", greeting.configuration}});
}

std::variant<Greeting, Refusal> readGreeting(std::string_view text) {
    return readLine<std::variant<Greeting, Refusal>>(
        text, [](const Value& json) -> std::variant<Greeting, Refusal> { return decodeGreeting(json); });
}

std::string requestLine(const WireRequest& request) {
    Entries entries;
    for (const KindName& row : kKindNames)
        if (row.kind == request.kind) entries.emplace("request", row.name);
    if (request.kind != Kind::cancel) entries.emplace("id", request.id);
    if (request.kind == Kind::test) entries.emplace("test", request.test);
    if (request.kind == Kind::test && request.configuration)
        entries.emplace("configuration", request.configuration);
    if (request.kind == Kind::setPower) entries.emplace("power", request.power);
    return line(std::move(entries));
}

std::variant<WireRequest, Refusal> readRequest(std::string_view text) {
    return readLine<std::variant<WireRequest, Refusal>>(
        text, [](const Value& json) -> std::variant<WireRequest, Refusal> { return decodeRequest(json); });
}

std::string testAnswerLine(std::uint64_t id, const DiagnosticsTestResponse& response) {
    Entries entries;
    encodeResponse(response, entries);
    return answerLine(id, std::move(entries));
}

std::string statusAnswerLine(std::uint64_t id, const DiagnosticsStatusResponse& response) {
    return answerLine(id, {{"status", encodeStatus(response)}});
}

std::string wifiAnswerLine(std::uint64_t id, const WiFiResponse& response) {
    Entries entries;
    if (response.wifi) entries.emplace("wifi", encodeWiFi(*response.wifi));
    if (response.error) entries.emplace("error", encodeError(*response.error));
    return answerLine(id, std::move(entries));
}

std::string setPowerAnswerLine(std::uint64_t id, const std::optional<Error>& error) {
    Entries entries;
    if (error) entries.emplace("error", encodeError(*error));
    return answerLine(id, std::move(entries));
}

std::string powerEventLine(bool power) {
    return line({{"event", Dictionary::make({{"power", power}})}});
}

std::string noteLine(std::string_view text) {
    return line({{"note", text}});
}

WireMessage readMessage(std::string_view text) {
    return readLine<WireMessage>(text, decodeMessage);
}

DiagnosticsTestResponse testAnswer(const WireAnswer& answer) {
    return readAnswer(answer, [](ObjectReader& reader) { return decodeResponse(reader); });
}

DiagnosticsStatusResponse statusAnswer(const WireAnswer& answer) {
    return readAnswer(answer, [](ObjectReader& reader) {
        return decodeStatus(reader.need("status"), Place(reader.place(), "status"));
    });
}

WiFiResponse wifiAnswer(const WireAnswer& answer) {
    return readAnswer(answer, [](ObjectReader& reader) {
        WiFiResponse response;
        response.error = takeError(reader);
        if (const Value* wifi = reader.find("wifi"))
            response.wifi = decodeWiFi(*wifi, Place(reader.place(), "wifi"));
        if (!response.error && !response.wifi) reader.place().refuse("needs the key \"wifi\"");
        return response;
    });
}

std::optional<Error> setPowerAnswer(const WireAnswer& answer) {
    return readAnswer(answer, [](ObjectReader& reader) { return takeError(reader); });
}

}  // namespace wp
