#include "exchange/recording.h"

#include <gtest/gtest.h>

#include "exchange/whole_file.h"
#include "platform/records.h"
#include "verification/unit/exchange/recordings.h"
#include "verification/unit/fakes/temporary_folder.h"

namespace wp {
namespace {

std::string refusalIn(const std::variant<Recording, Refusal>& outcome) {
    auto* refused = std::get_if<Refusal>(&outcome);
    return refused ? refused->text() : "accepted";
}

/// The refusal of a recording with these keys beside format and version.
std::string refusalOfKeys(const std::string& keys) {
    return refusalIn(readStated(keys));
}

std::string rawRefusal(const std::string& text) {
    return refusalIn(readRecording(text));
}

TEST(Recording, MayLeaveOutEverythingButFormatAndVersion) {
    Recording recording = accepted(loadRecording(kFolder + "smallest.json"));

    EXPECT_EQ(recording.wifi, (WiFiDescription{true, true, {"wlan0"}, true, {}}));
    EXPECT_TRUE(recording.capabilities.empty() && recording.status.empty() && recording.answers.empty() &&
                recording.events.empty());
    EXPECT_FALSE(recording.automation);
}

TEST(Recording, HoldsWhatTheFileSays) {
    Recording recording = accepted(loadRecording(kFolder + "every_form.json"));

    EXPECT_EQ(recording.description, "every form an entry can take");
    EXPECT_TRUE(recording.capabilities.at("wapi"));
    EXPECT_TRUE(recording.automation);
    EXPECT_FALSE(recording.wifi.power);
    ASSERT_EQ(recording.status.size(), 3U);
    EXPECT_EQ(recording.status[0].status->ssid, "Northlight");
    EXPECT_EQ(recording.status[2].error, (Error{1, "no interface"}));
    ASSERT_EQ(recording.answers.size(), 11U);
    EXPECT_EQ(recording.answers[1].networkName, "Office");
    EXPECT_EQ(recording.answers[1].delay, std::chrono::milliseconds(20));
    EXPECT_EQ(recording.answers[2].maxScanCacheAge, Value(0));
    EXPECT_TRUE(recording.answers[4].response.results->empty());
    EXPECT_FALSE(recording.answers[7].response.results);
    ASSERT_EQ(recording.events.size(), 2U);
    EXPECT_EQ(recording.events[0].after, std::chrono::milliseconds(1500));
    EXPECT_FALSE(recording.events[0].power);
}

TEST(Recording, IsWrittenAsItIsRead) {
    Recording recording = accepted(loadRecording(kFolder + "every_form.json"));

    std::string text = recordingText(recording);

    EXPECT_EQ(recordingText(accepted(readRecording(text))), text);
    EXPECT_NE(text.find(R"("lastJoined": "2024-05-01T12:00:00.5Z")"), std::string::npos);
    EXPECT_NE(text.find(R"("packetLoss": 0.0)"), std::string::npos);
    EXPECT_EQ(text.find("gone"), std::string::npos);
    EXPECT_EQ(text.back(), '\n');
}

TEST(Recording, RefusesAFileOfAnotherKindOrVersion) {
    EXPECT_EQ(rawRefusal("[]"), "must be an object");
    EXPECT_EQ(rawRefusal(R"({"version": 1})"), R"(needs the key "format")");
    EXPECT_EQ(rawRefusal(R"({"format": "x", "version": 1})"), R"(format: must be "wifi-profile-recording")");
    EXPECT_EQ(rawRefusal(R"({"format": "wifi-profile-recording"})"), R"(needs the key "version")");
    EXPECT_EQ(rawRefusal(R"({"format": "wifi-profile-recording", "version": 2, "new": 1})"),
              "version: must be 1");
    EXPECT_EQ(rawRefusal(R"({"format": "wifi-profile-recording", "version": 1.0})"), "version: must be 1");
}

TEST(Recording, RefusesUnknownKeysOutsideInfo) {
    EXPECT_EQ(refusalOfKeys(R"("answer": [])"), "answer: unknown key");
    EXPECT_EQ(refusalOfKeys(R"("answers": [{"test": 1, "delay": 3}])"), "answers[0].delay: unknown key");
    EXPECT_EQ(refusalOfKeys(R"("status": [{}, {"SSID": "x"}])"), "status[1].SSID: unknown key");
    EXPECT_EQ(refusalOfKeys(R"("events": [{"afterMs": 1, "power": true, "why": ""}])"),
              "events[0].why: unknown key");
    EXPECT_EQ(refusalOfKeys(R"("answers": [{"test": 1, "info": {"anything": 1}}])"), "accepted");
}

TEST(Recording, RefusesValuesOfAnotherKindWithTheirPlace) {
    EXPECT_EQ(refusalOfKeys(R"("description": 1)"), "description: must be a text");
    EXPECT_EQ(refusalOfKeys(R"("capabilities": {"wapi": 1})"), "capabilities.wapi: must be true or false");
    EXPECT_EQ(refusalOfKeys(R"("capabilities": [])"), "capabilities: must be an object");
    EXPECT_EQ(refusalOfKeys(R"("automation": null)"), "automation: must be true or false");
    EXPECT_EQ(refusalOfKeys(R"("wifi": {"power": 1})"), "wifi.power: must be true or false");
    EXPECT_EQ(refusalOfKeys(R"("status": {})"), "status: must be an array");
    EXPECT_EQ(refusalOfKeys(R"("answers": [[]])"), "answers[0]: must be an object");
    EXPECT_EQ(refusalOfKeys(R"("answers": [{}])"), R"(answers[0]: needs the key "test")");
    EXPECT_EQ(refusalOfKeys(R"("answers": [{"test": "14"}])"),
              "answers[0].test: must be an integer from 0 to 2147483647");
    EXPECT_EQ(refusalOfKeys(R"("answers": [{"test": 1, "networkName": null}])"),
              "answers[0].networkName: must be a text");
    EXPECT_EQ(refusalOfKeys(R"("answers": [{"test": 1, "maxScanCacheAge": "0"}])"),
              "answers[0].maxScanCacheAge: must be a number");
    EXPECT_EQ(refusalOfKeys(R"("events": [{"power": true}])"), R"(events[0]: needs the key "afterMs")");
}

TEST(Recording, RefusesDelaysThatAreNoWholeMilliseconds) {
    for (const char* delay : {"-1", "1.5", "2147483648", "\"1\"", "null"})
        EXPECT_EQ(
            refusalOfKeys(R"("answers": [{"test": 1}, {"test": 1, "delayMs": )" + std::string(delay) + "}]"),
            "answers[1].delayMs: must be an integer from 0 to 2147483647");
    EXPECT_EQ(refusalOfKeys(R"("events": [{"afterMs": -1, "power": true}])"),
              "events[0].afterMs: must be an integer from 0 to 2147483647");
}

TEST(Recording, RefusesAnIntegerBeyond64BitsInsideInfo) {
    EXPECT_EQ(refusalOfKeys(R"("answers": [{"test": 1, "info": {"a": [18446744073709551616]}}])"),
              "answers[0].info.a[0]: an integer beyond 64 bits");
}

TEST(Recording, RefusesResultsBesideTheShortForm) {
    EXPECT_EQ(refusalOfKeys(R"("answers": [{"test": 1, "results": [], "info": {}}])"),
              R"(answers[0].results: cannot stand beside "result", "didPass" or "info")");
}

TEST(Recording, SaysWhyAFileCannotBeRead) {
    auto reason = [](const std::string& path) {
        auto outcome = loadRecording(path);
        return std::get<Refusal>(outcome).text();
    };
    EXPECT_EQ(reason("/nonexistent/file"), "cannot be opened: No such file or directory");
    EXPECT_EQ(reason("/"), "cannot be read: Is a directory");
}

TEST(Recording, TakesAScanOfTenThousandNetworks) {
    Recording recording;
    Array heard;
    for (int i = 0; i < 10'000; ++i) {
        auto entry = std::make_shared<WiFiScanResult>();
        entry->ssid = "Network " + std::to_string(i);
        entry->rssi = -i % 90;
        heard.push_back(entry);
    }
    RecordedAnswer scan;
    scan.test = 31;
    scan.response.results = {std::make_shared<const DiagnosticsTestResult>(
        DiagnosticsTestResult{false, true, Dictionary::make({{"ScanResults", heard}})})};
    recording.answers.push_back(scan);

    Recording read = accepted(readRecording(recordingText(recording)));

    Value scanResults = *read.answers[0].response.results->front()->info->value("ScanResults");
    EXPECT_EQ((*scanResults.as<ArrayPointer>())->size(), 10'000U);
    EXPECT_EQ((*scanResults.as<ArrayPointer>())->back().asRecord<WiFiScanResult>()->ssid, "Network 9999");
}

TEST(WholeFile, RefusesToReadBeyondTheLimit) {
    const fakes::TemporaryFolder folder;
    folder.write("big", std::string(100, 'x'));
    EXPECT_EQ(std::get<Refusal>(readWholeFile(folder / "big", 99)).text(), "longer than 99 bytes");
    EXPECT_EQ(std::get<std::string>(readWholeFile(folder / "big", 100)).size(), 100U);
}

}  // namespace
}  // namespace wp
