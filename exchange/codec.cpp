#include "exchange/codec.h"

#include <limits>
#include <type_traits>

#include "exchange/date_text.h"
#include "exchange/record_forms.h"

namespace wp {
namespace {

using Entries = Dictionary::Entries;

/// The value with every record and date in it in its JSON form.
Value plainValue(const Value& value) {
    return std::visit(
        [&value](const auto& content) -> Value {
            using Content = std::decay_t<decltype(content)>;
            if constexpr (std::is_same_v<Content, RecordPointer>) {
                return content ? encodeRecord(*content) : Value();
            } else if constexpr (std::is_same_v<Content, Date>) {
                return exactISO8601Text(content);
            } else if constexpr (std::is_same_v<Content, ArrayPointer>) {
                Array elements;
                if (!content) return Value();
                for (const Value& element : *content) elements.push_back(plainValue(element));
                return elements;
            } else if constexpr (std::is_same_v<Content, DictionaryPointer>) {
                Entries entries;
                if (!content) return Value();
                for (const auto& [key, entry] : content->entries()) entries.emplace(key, plainValue(entry));
                return Dictionary::make(std::move(entries));
            } else {
                return value;
            }
        },
        value.storage());
}

void encodeResult(const DiagnosticsTestResult& result, Entries& into) {
    into.insert_or_assign("result", result.result);
    into.insert_or_assign("didPass", result.didPass);
    if (result.info) into.insert_or_assign("info", encodeInfo(*result.info));
}

/// The result whose keys the reader holds; null where it holds none of them.
DiagnosticsTestResultPointer takeResult(ObjectReader& reader) {
    const Value* verdict = reader.find("result");
    const Value* didPass = reader.find("didPass");
    const Value* info = reader.find("info");
    if (!verdict && !didPass && !info) return nullptr;
    auto result = std::make_shared<DiagnosticsTestResult>();
    if (verdict) result->result = readFlag(*verdict, Place(reader.place(), "result"));
    if (didPass) result->didPass = readFlag(*didPass, Place(reader.place(), "didPass"));
    if (info) result->info = decodeInfo(*info, Place(reader.place(), "info"));
    return result;
}

DiagnosticsTestResultPointer decodeResult(const Value& json, const Place& place) {
    if (json.isNull()) return nullptr;
    ObjectReader reader(json, place);
    DiagnosticsTestResultPointer result = takeResult(reader);
    reader.finish();
    return result ? result : std::make_shared<const DiagnosticsTestResult>();
}

std::optional<DiagnosticsTestResults> decodeResults(const Value& json, const Place& place) {
    if (json.isNull()) return std::nullopt;
    ArrayPointer elements = readArray(json, place);
    DiagnosticsTestResults results;
    for (std::size_t i = 0; i < elements->size(); ++i)
        results.push_back(decodeResult((*elements)[i], Place(place, i)));
    return results;
}

std::vector<std::string> decodeDevices(const Value& json, const Place& place) {
    ArrayPointer elements = readArray(json, place);
    std::vector<std::string> devices;
    for (std::size_t i = 0; i < elements->size(); ++i) {
        Place at(place, i);
        devices.push_back(readText((*elements)[i], at));
        if (devices.back().empty()) at.refuse("must not be empty");
    }
    return devices;
}

WiFiDescription::SetPower decodeSetPower(const Value& json, const Place& place) {
    std::string word = readText(json, place);
    if (word == "works") return WiFiDescription::SetPower::works;
    if (word == "ignored") return WiFiDescription::SetPower::ignored;
    place.refuse("must be \"works\" or \"ignored\"");
}

}  // namespace

Value encodeInfo(const Dictionary& info) {
    Entries entries;
    for (const auto& [key, value] : info.entries()) {
        Value plain = plainValue(value);
        if (!plain.isNull()) entries.emplace(key, std::move(plain));
    }
    return Dictionary::make(std::move(entries));
}

DictionaryPointer decodeInfo(const Value& json, const Place& place) {
    const auto* object = json.as<DictionaryPointer>();
    if (!object) place.refuse("must be an object");
    Entries entries;
    for (const auto& [key, value] : (*object)->entries()) {
        if (value.isNull()) continue;
        entries.emplace(key, isRecordKey(key) ? decodeRecord(key, value, Place(place, key)) : value);
    }
    return Dictionary::make(std::move(entries));
}

Value encodeError(const Error& error) {
    return Dictionary::make({{"code", error.code}, {"message", error.message}});
}

Error decodeError(const Value& json, const Place& place) {
    using Limits = std::numeric_limits<int>;
    ObjectReader reader(json, place);
    Error error;
    Place code(place, "code");
    error.code = static_cast<int>(readInteger(reader.need("code"), code, Limits::min(), Limits::max()));
    error.message = readText(reader.need("message"), Place(place, "message"));
    reader.finish();
    return error;
}

void encodeResponse(const DiagnosticsTestResponse& response, Entries& into) {
    if (response.error) into.insert_or_assign("error", encodeError(*response.error));
    if (!response.results) return;
    const DiagnosticsTestResults& results = *response.results;
    if (results.size() == 1 && results.front()) return encodeResult(*results.front(), into);
    Array elements;
    for (const DiagnosticsTestResultPointer& result : results) {
        Entries entries;
        if (result) encodeResult(*result, entries);
        elements.push_back(result ? Value(Dictionary::make(std::move(entries))) : Value());
    }
    into.insert_or_assign("results", std::move(elements));
}

DiagnosticsTestResponse decodeResponse(ObjectReader& reader) {
    DiagnosticsTestResponse response;
    const Value* results = reader.find("results");
    DiagnosticsTestResultPointer single = takeResult(reader);
    Place resultsPlace(reader.place(), "results");
    if (results && single) resultsPlace.refuse("cannot stand beside \"result\", \"didPass\" or \"info\"");
    if (results) response.results = decodeResults(*results, resultsPlace);
    if (single) response.results = DiagnosticsTestResults{single};
    if (const Value* error = reader.find("error"))
        response.error = decodeError(*error, Place(reader.place(), "error"));
    return response;
}

Value encodeStatus(const DiagnosticsStatusResponse& response) {
    Entries entries;
    if (response.status && response.status->ssid) entries.emplace("ssid", *response.status->ssid);
    if (response.status && response.status->bssid) entries.emplace("bssid", *response.status->bssid);
    if (response.error) entries.emplace("error", encodeError(*response.error));
    return Dictionary::make(std::move(entries));
}

DiagnosticsStatusResponse decodeStatus(const Value& json, const Place& place) {
    ObjectReader reader(json, place);
    DiagnosticsStatusResponse response;
    auto status = std::make_shared<WiFiStatus>();
    if (const Value* ssid = reader.findNonNull("ssid")) status->ssid = readText(*ssid, Place(place, "ssid"));
    if (const Value* bssid = reader.findNonNull("bssid"))
        status->bssid = readText(*bssid, Place(place, "bssid"));
    if (const Value* error = reader.find("error"))
        response.error = decodeError(*error, Place(place, "error"));
    reader.finish();
    if (!response.error || status->ssid || status->bssid) response.status = std::move(status);
    return response;
}

Value encodeWiFi(const WiFiDescription& wifi) {
    Array devices(wifi.devices.begin(), wifi.devices.end());
    Entries entries{{"radio", wifi.radio},
                    {"client", wifi.client},
                    {"devices", std::move(devices)},
                    {"power", wifi.power}};
    if (wifi.setPower == WiFiDescription::SetPower::ignored) entries.emplace("setPower", "ignored");
    return Dictionary::make(std::move(entries));
}

WiFiDescription decodeWiFi(const Value& json, const Place& place) {
    ObjectReader reader(json, place);
    WiFiDescription wifi;
    if (const Value* radio = reader.find("radio")) wifi.radio = readFlag(*radio, Place(place, "radio"));
    if (const Value* client = reader.find("client")) wifi.client = readFlag(*client, Place(place, "client"));
    if (const Value* devices = reader.find("devices"))
        wifi.devices = decodeDevices(*devices, Place(place, "devices"));
    if (const Value* power = reader.find("power")) wifi.power = readFlag(*power, Place(place, "power"));
    if (const Value* word = reader.find("setPower"))
        wifi.setPower = decodeSetPower(*word, Place(place, "setPower"));
    reader.finish();
    return wifi;
}

}  // namespace wp
