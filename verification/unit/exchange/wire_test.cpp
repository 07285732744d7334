#include "exchange/wire.h"

#include <gtest/gtest.h>

namespace wp {
namespace {

using Kind = WireRequest::Kind;

std::string_view withoutNewline(std::string_view line) {
    EXPECT_TRUE(line.ends_with('\n'));
    EXPECT_EQ(line.find('\n'), line.size() - 1);
    return line.substr(0, line.size() - 1);
}

WireRequest request(std::string_view line) {
    auto outcome = readRequest(line);
    if (auto* refusal = std::get_if<Refusal>(&outcome)) ADD_FAILURE() << refusal->text();
    return std::holds_alternative<WireRequest>(outcome) ? std::get<WireRequest>(outcome) : WireRequest{};
}

std::string requestRefusal(std::string_view line) {
    auto outcome = readRequest(line);
    auto* refusal = std::get_if<Refusal>(&outcome);
    return refusal ? refusal->text() : "accepted";
}

WireAnswer answer(const std::string& line) {
    WireMessage message = readMessage(withoutNewline(line));
    auto* read = std::get_if<WireAnswer>(&message);
    if (!read) ADD_FAILURE() << line;
    return read ? *read : WireAnswer{};
}

Greeting greeting(std::string_view line) {
    auto outcome = readGreeting(line);
    if (auto* refusal = std::get_if<Refusal>(&outcome)) ADD_FAILURE() << refusal->text();
    return std::holds_alternative<Greeting>(outcome) ? std::get<Greeting>(outcome) : Greeting{};
}

std::string greetingRefusal(std::string_view line) {
    auto outcome = readGreeting(line);
    auto* refusal = std::get_if<Refusal>(&outcome);
    return refusal ? refusal->text() : "accepted";
}

TEST(Wire, CarriesBothGreetings) {
    const std::string told = greetingLine({Dictionary::make({{"thresholds", 7}}), ""});
    EXPECT_EQ(told, "{\"configuration\":{\"thresholds\":7}}\n");
    EXPECT_EQ(greeting(withoutNewline(told)).configuration->value("thresholds"), Value(7));

    const std::string refused = greetingLine({nullptr, "a.json: endpoints: must be an object"});
    EXPECT_EQ(refused, "{\"refused\":\"a.json: endpoints: must be an object\"}\n");
    EXPECT_EQ(greeting(withoutNewline(refused)).configuration, nullptr);
    EXPECT_EQ(greeting(withoutNewline(refused)).refused, "a.json: endpoints: must be an object");
}

TEST(Wire, RefusesGreetingsOfAnotherForm) {
    EXPECT_EQ(greetingRefusal("{}"), R"(needs the key "refused")");
    EXPECT_EQ(greetingRefusal(R"({"configuration":true})"), "configuration: must be an object");
    EXPECT_EQ(greetingRefusal(R"({"configuration":{},"refused":"x"})"), "refused: unknown key");
    EXPECT_EQ(greetingRefusal(R"({"refused":7})"), "refused: must be a text");
}

TEST(Wire, CarriesEveryRequest) {
    WireRequest test{Kind::test, 7, 34, Dictionary::make({{"NetworkName", "Line\nbreak"}}), false};
    EXPECT_EQ(requestLine(test),
              "{\"configuration\":{\"NetworkName\":\"Line\\nbreak\"},\"id\":7,"
              "\"request\":\"test\",\"test\":34}\n");
    WireRequest read = request(withoutNewline(requestLine(test)));
    EXPECT_EQ(read.kind, Kind::test);
    EXPECT_EQ(read.id, 7U);
    EXPECT_EQ(read.test, 34);
    EXPECT_EQ(read.configuration->value("NetworkName"), Value("Line\nbreak"));

    EXPECT_EQ(requestLine({Kind::status, 1, 0, nullptr, false}), "{\"id\":1,\"request\":\"status\"}\n");
    EXPECT_EQ(requestLine({Kind::cancel, 9, 0, nullptr, false}), "{\"request\":\"cancel\"}\n");
    EXPECT_EQ(request(R"({"id":2,"request":"wifi"})").kind, Kind::wifi);
    EXPECT_TRUE(request(R"({"id":3,"request":"setPower","power":true})").power);
    EXPECT_EQ(request(R"({"id":4,"request":"test","test":1})").configuration, nullptr);
}

TEST(Wire, RefusesRequestsOfAnotherForm) {
    EXPECT_EQ(requestRefusal(R"({"id":1,"request":"reboot"})"), "request: no such request");
    EXPECT_EQ(requestRefusal(R"({"request":"status"})"), R"(needs the key "id")");
    EXPECT_EQ(requestRefusal(R"({"id":-1,"request":"status"})"),
              "id: must be an integer from 0 to 9223372036854775807");
    EXPECT_EQ(requestRefusal(R"({"id":1,"request":"status","test":3})"), "test: unknown key");
    EXPECT_EQ(requestRefusal(R"({"id":1,"request":"test","test":3,"configuration":[]})"),
              "configuration: must be an object");
    EXPECT_EQ(requestRefusal("[]"), "must be an object");
}

TEST(Wire, CarriesEveryAnswer) {
    DiagnosticsTestResponse response{std::nullopt, Error{7, "busy"}};
    WireAnswer test = answer(testAnswerLine(5, response));
    EXPECT_EQ(test.id, 5U);
    EXPECT_EQ(testAnswer(test).error, response.error);

    auto status = std::make_shared<WiFiStatus>();
    status->ssid = "Home";
    EXPECT_EQ(statusAnswer(answer(statusAnswerLine(6, {status, std::nullopt}))).status->ssid, "Home");

    WiFiDescription wifi{true, true, {"wlan1"}, false, {}};
    EXPECT_EQ(wifiAnswer(answer(wifiAnswerLine(7, {wifi, std::nullopt}))).wifi, wifi);
    EXPECT_EQ(wifiAnswer(answer(wifiAnswerLine(7, {std::nullopt, Error{4, "x"}}))).error, (Error{4, "x"}));

    EXPECT_EQ(setPowerAnswerLine(8, std::nullopt), "{\"id\":8}\n");
    EXPECT_EQ(setPowerAnswer(answer(setPowerAnswerLine(8, Error{6, "no"}))), (Error{6, "no"}));
}

TEST(Wire, CarriesEventsAndNotes) {
    EXPECT_EQ(powerEventLine(false), "{\"event\":{\"power\":false}}\n");
    WireMessage event = readMessage(withoutNewline(powerEventLine(true)));
    EXPECT_TRUE(std::get<PowerEvent>(event).power);
    WireMessage note = readMessage(withoutNewline(noteLine("no permission to scan")));
    EXPECT_EQ(std::get<Note>(note).text, "no permission to scan");
}

TEST(Wire, RefusesMessagesOfAnotherForm) {
    for (const char* line : {"", "nonsense", "[]", "{}", R"({"id":"1"})", R"({"event":{}})", R"({"note":1})",
                             R"({"event":{"power":true},"id":1})", R"({"note":"a","extra":1})"})
        EXPECT_TRUE(std::holds_alternative<Refusal>(readMessage(line))) << line;
    auto json = [](const char* line) { return std::get<WireAnswer>(readMessage(line)); };
    EXPECT_THROW(testAnswer(json(R"({"id":1,"status":{}})")), Refused);
    EXPECT_THROW(statusAnswer(json(R"({"id":1})")), Refused);
    EXPECT_THROW(wifiAnswer(json(R"({"id":1})")), Refused);
    EXPECT_THROW(setPowerAnswer(json(R"({"id":1,"power":true})")), Refused);
}

}  // namespace
}  // namespace wp
