#include "exchange/codec.h"

#include <gtest/gtest.h>

#include <cmath>

#include "exchange/json_reader.h"
#include "platform/json_writer.h"
#include "platform/records.h"

namespace wp {
namespace {

Value json(std::string_view text) {
    auto outcome = readJSON(text);
    if (auto* refusal = std::get_if<Refusal>(&outcome)) ADD_FAILURE() << refusal->text();
    return std::holds_alternative<Value>(outcome) ? std::get<Value>(outcome) : Value();
}

/// What `decode` makes of the text, or the refusal's text.
template <class Decode>
std::string refusalOf(Decode decode, std::string_view text) {
    try {
        Place top;
        decode(json(text), top);
        return "accepted";
    } catch (const Refused& refused) {
        return refused.what();
    }
}

DictionaryPointer info(std::string_view text) {
    Place top;
    return decodeInfo(json(text), top);
}

std::string infoRefusal(std::string_view text) {
    return refusalOf([](const Value& value, const Place& place) { decodeInfo(value, place); }, text);
}

DiagnosticsTestResponse response(std::string_view text) {
    Place top;
    ObjectReader reader(json(text), top);
    DiagnosticsTestResponse decoded = decodeResponse(reader);
    reader.finish();
    return decoded;
}

std::string responseRefusal(std::string_view text) {
    return refusalOf(
        [](const Value& value, const Place& place) {
            ObjectReader reader(value, place);
            decodeResponse(reader);
            reader.finish();
        },
        text);
}

std::string written(const DiagnosticsTestResponse& response) {
    Dictionary::Entries entries;
    encodeResponse(response, entries);
    return jsonText(Dictionary::make(std::move(entries)), JSONStyle::compact);
}

TEST(Codec, LeavesOutNullKeysOfInfoAndKeepsNullsNestedDeeper) {
    DictionaryPointer decoded = info(R"({"gone": null, "list": [null], "map": {"key": null}, "n": 1})");

    EXPECT_FALSE(decoded->value("gone"));
    EXPECT_EQ(decoded->value("list"), Value(Array{NullMarker{}}));
    EXPECT_EQ(decoded->value("map"), Value(Dictionary::make({{"key", NullMarker{}}})));
    EXPECT_EQ(decoded->value("n"), Value(1));
}

TEST(Codec, ReadsAPreferredNetworkRecord) {
    auto record = info(R"({"PreferredNetwork": {"ssid": "Home", "security": 4, "passpoint": true,
        "enabled": true, "captive": true, "hidden": true, "multiAP": true,
        "lastJoined": "2001-01-01T01:00:00+01:00"}})")
                      ->value("PreferredNetwork")
                      ->asRecord<PreferredNetworkRecord>();

    ASSERT_TRUE(record);
    EXPECT_EQ(record->ssid, "Home");
    EXPECT_EQ(record->security, 4);
    EXPECT_TRUE(record->passpoint && record->enabled && record->captive && record->hidden && record->multiAP);
    EXPECT_EQ(record->lastJoined, Date{0});
}

TEST(Codec, FillsInWhatARecordLeavesOutOrHasNull) {
    DictionaryPointer decoded = info(R"({"PreferredNetwork": {"ssid": null, "hidden": null},
        "PingResult": {"min": null}, "CurrentChannel": {}, "ScanResults": [{}]})");

    auto preferred = decoded->value("PreferredNetwork")->asRecord<PreferredNetworkRecord>();
    EXPECT_FALSE(preferred->ssid || preferred->lastJoined || preferred->hidden || preferred->enabled);
    EXPECT_EQ(preferred->security, 0);
    auto ping = decoded->value("PingResult")->asRecord<PingStatistics>();
    EXPECT_FALSE(ping->interfaceName);
    EXPECT_EQ(ping->count, 0);
    EXPECT_EQ(ping->timestamp, 0);
    for (double number : {ping->packetLoss, ping->min, ping->max, ping->avg, ping->stddev})
        EXPECT_TRUE(std::isnan(number));
    EXPECT_EQ(decoded->value("CurrentChannel")->asRecord<WiFiChannel>()->channel, 0);
    ArrayPointer scan = *decoded->value("ScanResults")->as<ArrayPointer>();
    auto heard = scan->front().asRecord<WiFiScanResult>();
    EXPECT_FALSE(heard->ssid || heard->bssid);
    EXPECT_EQ(heard->rssi, 0);
}

TEST(Codec, ReadsLossTimesAndTimestampAsDoublesWhateverTheyLookLike) {
    auto ping = info(R"({"PingResult": {"interface": "wlan0", "count": 10, "packetLoss": 0, "min": 1,
        "max": 3, "avg": 2.5, "stddev": 1, "timestamp": 18446744073709551615}})")
                    ->value("PingResult")
                    ->asRecord<PingStatistics>();

    EXPECT_EQ(ping->interfaceName, "wlan0");
    EXPECT_EQ(ping->count, 10);
    EXPECT_EQ(ping->packetLoss, 0.0);
    EXPECT_EQ(ping->max, 3.0);
    EXPECT_EQ(ping->avg, 2.5);
    EXPECT_EQ(ping->timestamp, 18446744073709551615.0);
}

TEST(Codec, ReadsAllFiveChannelKeysAsChannels) {
    DictionaryPointer decoded = info(R"({"CurrentChannel": {"channel": 1}, "2GHzChannel": {"channel": 6},
        "5GHzChannel": {"channel": 36}, "5GHz40MHzChannel": {"channel": 44},
        "5GHzNonDFSChannel": {"channel": 149}, "OtherChannel": {"channel": 7}})");

    for (auto [key, number] : std::map<std::string, int>{{"CurrentChannel", 1},
                                                         {"2GHzChannel", 6},
                                                         {"5GHzChannel", 36},
                                                         {"5GHz40MHzChannel", 44},
                                                         {"5GHzNonDFSChannel", 149}})
        EXPECT_EQ(decoded->value(key)->asRecord<WiFiChannel>()->channel, number) << key;
    EXPECT_EQ(decoded->value("OtherChannel"), Value(Dictionary::make({{"channel", 7}})));
}

TEST(Codec, RefusesARecordOfAnotherFormWithPlaceAndReason) {
    EXPECT_EQ(infoRefusal(R"({"PreferredNetwork": "Home"})"), "PreferredNetwork: must be an object");
    EXPECT_EQ(infoRefusal(R"({"PreferredNetwork": {"SSID": "Home"}})"), "PreferredNetwork.SSID: unknown key");
    EXPECT_EQ(infoRefusal(R"({"PreferredNetwork": {"security": 1.0}})"),
              "PreferredNetwork.security: must be a signed 64-bit integer");
    EXPECT_EQ(infoRefusal(R"({"PreferredNetwork": {"hidden": 0}})"),
              "PreferredNetwork.hidden: must be true or false");
    EXPECT_EQ(infoRefusal(R"({"PreferredNetwork": {"lastJoined": "yesterday"}})"),
              "PreferredNetwork.lastJoined: must be an ISO 8601 time with its zone, such as "
              "2024-05-01T12:00:00Z");
    EXPECT_EQ(infoRefusal(R"({"PingResult": {"avg": "1"}})"), "PingResult.avg: must be a number");
    EXPECT_EQ(infoRefusal(R"({"2GHzChannel": 6})"), R"(2GHzChannel: must be an object)");
    EXPECT_EQ(infoRefusal(R"({"ScanResults": {}})"), "ScanResults: must be an array");
    EXPECT_EQ(infoRefusal(R"({"ScanResults": [{}, null]})"), "ScanResults[1]: must be an object");
    EXPECT_EQ(infoRefusal(R"({"ScanResults": [{"rssi": 9223372036854775808}]})"),
              "ScanResults[0].rssi: must be a signed 64-bit integer");
    EXPECT_EQ(infoRefusal("[]"), "must be an object");
}

TEST(Codec, WritesRecordsInTheFormThatItReads) {
    constexpr std::string_view text =
        R"({"2GHzChannel":{"channel":6},)"
        R"("PingResult":{"avg":1.5,"count":10,"interface":"wlan0","max":2.0,"min":null,"packetLoss":0.1,)"
        R"("stddev":null,"timestamp":736000000.25},)"
        R"("PreferredNetwork":{"captive":false,"enabled":true,"hidden":false,)"
        R"("lastJoined":"2024-05-01T12:00:00.5Z","multiAP":true,"passpoint":false,"security":4,"ssid":"Home"},)"
        R"("ScanResults":[{"bssid":"02:00:00:00:00:01","rssi":-40,"ssid":"Home"},{"rssi":-70}],)"
        R"("nested":[{"deep":null}]})";
    EXPECT_EQ(jsonText(encodeInfo(*info(text)), JSONStyle::compact), text);
}

TEST(Codec, ReadsTheShortFormOfOneResult) {
    DiagnosticsTestResponse decoded = response(R"({"result": true, "info": {"a": 1}})");

    ASSERT_TRUE(decoded.results);
    ASSERT_EQ(decoded.results->size(), 1U);
    EXPECT_TRUE(decoded.results->front()->result);
    EXPECT_FALSE(decoded.results->front()->didPass);
    EXPECT_EQ(decoded.results->front()->info->value("a"), Value(1));
    EXPECT_FALSE(decoded.error);
    EXPECT_FALSE(response(R"({"didPass": true})").results->front()->info);
}

TEST(Codec, TellsAbsentEmptyAndHollowResultsApart) {
    EXPECT_FALSE(response("{}").results);
    EXPECT_FALSE(response(R"({"results": null})").results);
    EXPECT_TRUE(response(R"({"results": []})").results->empty());
    EXPECT_EQ(response(R"({"results": [null]})").results->front(), nullptr);
    EXPECT_TRUE(response(R"({"results": [{}, {"result": true}]})").results->front());
}

TEST(Codec, ReadsAnErrorBesideResults) {
    DiagnosticsTestResponse decoded =
        response(R"({"error": {"code": 0, "message": ""}, "result": true, "didPass": true})");
    EXPECT_EQ(decoded.error, (Error{0, ""}));
    EXPECT_TRUE(decoded.results->front()->didPass);
}

TEST(Codec, RefusesAnAnswerOfAnotherForm) {
    EXPECT_EQ(responseRefusal(R"({"results": [], "didPass": true})"),
              R"(results: cannot stand beside "result", "didPass" or "info")");
    EXPECT_EQ(responseRefusal(R"({"result": 1})"), "result: must be true or false");
    EXPECT_EQ(responseRefusal(R"({"info": null})"), "info: must be an object");
    EXPECT_EQ(responseRefusal(R"({"results": [{"verdict": true}]})"), "results[0].verdict: unknown key");
    EXPECT_EQ(responseRefusal(R"({"error": {"code": 7}})"), R"(error: needs the key "message")");
    EXPECT_EQ(responseRefusal(R"({"error": {"code": 2147483648, "message": ""}})"),
              "error.code: must be an integer from -2147483648 to 2147483647");
    EXPECT_EQ(responseRefusal(R"({"error": {"code": 7, "message": "", "domain": "x"}})"),
              "error.domain: unknown key");
    EXPECT_EQ(responseRefusal(R"({"error": null})"), "error: must be an object");
}

TEST(Codec, WritesAnswersAsItReadsThem) {
    for (const char* text :
         {R"({})", R"({"results":[]})", R"({"results":[null]})", R"({"didPass":false,"result":true})",
          R"({"didPass":true,"info":{},"result":false})", R"({"error":{"code":7,"message":"radio busy"}})",
          R"({"results":[{"didPass":true,"result":true},null]})",
          R"({"didPass":true,"error":{"code":0,"message":"x"},"result":true})"})
        EXPECT_EQ(written(response(text)), text);
}

TEST(Codec, ReadsAndWritesStatuses) {
    Place top;
    auto read = [&](const char* text) { return decodeStatus(json(text), top); };

    DiagnosticsStatusResponse joined = read(R"({"ssid": "Home", "bssid": "02:00:00:00:00:01"})");
    EXPECT_EQ(joined.status->ssid, "Home");
    EXPECT_EQ(joined.status->bssid, "02:00:00:00:00:01");
    EXPECT_FALSE(joined.error);
    ASSERT_TRUE(read("{}").status);
    EXPECT_FALSE(read("{}").status->ssid);
    EXPECT_FALSE(read(R"({"error": {"code": 1, "message": "no interface"}})").status);
    EXPECT_TRUE(read(R"({"ssid": "Home", "error": {"code": 0, "message": ""}})").status);
    for (const char* text :
         {"{}", R"({"ssid":"Home"})", R"({"bssid":"b","error":{"code":1,"message":"m"},"ssid":"s"})"})
        EXPECT_EQ(jsonText(encodeStatus(read(text)), JSONStyle::compact), text);
}

TEST(Codec, ReadsAndWritesWiFiDescriptions) {
    Place top;
    WiFiDescription wanted{true, false, {"wlan0", "wlan1"}, false, WiFiDescription::SetPower::ignored};

    EXPECT_EQ(decodeWiFi(encodeWiFi(wanted), top), wanted);
    EXPECT_EQ(decodeWiFi(json("{}"), top), WiFiDescription());
    EXPECT_EQ(jsonText(encodeWiFi({}), JSONStyle::compact),
              R"({"client":true,"devices":["wlan0"],"power":true,"radio":true})");
    auto refused = [](const char* text) {
        return refusalOf([](const Value& value, const Place& place) { decodeWiFi(value, place); }, text);
    };
    EXPECT_EQ(refused(R"({"setPower": "maybe"})"), R"(setPower: must be "works" or "ignored")");
    EXPECT_EQ(refused(R"({"devices": [""]})"), "devices[0]: must not be empty");
    EXPECT_EQ(refused(R"({"radios": true})"), "radios: unknown key");
}

}  // namespace
}  // namespace wp
