#include <cmath>

#include "verification/unit/tests/catalogue_fixture.h"

namespace wp::rows {
namespace {

using fakes::outcome;
using Entries = Dictionary::Entries;
using Lines = std::vector<std::string>;

std::shared_ptr<PingStatistics> statistics() {
    auto ping = std::make_shared<PingStatistics>();
    ping->interfaceName = "wlan0";
    ping->count = 5;
    ping->packetLoss = 0.2;
    ping->min = 1.5;
    ping->max = 9.5;
    ping->avg = 4.25;
    ping->stddev = 0.5;
    ping->timestamp = 0;
    return ping;
}

DiagnosticsTestResponse ping(bool result, bool didPass, std::shared_ptr<PingStatistics> record) {
    return outcome(result, didPass, Dictionary::make({{"PingResult", std::move(record)}}));
}

class PingTest : public CatalogueTest {
  protected:
    DictionaryPointer summaryOf(std::shared_ptr<PingStatistics> record) {
        service.setOutcome(3, ping(true, true, std::move(record)));
        controller.runCurrentNetworkPingLANWithConfiguration(configuration, results);
        return *results->value("pingLANResult")->as<DictionaryPointer>();
    }
};

TEST_F(PingTest, SummarisesAPingOfTheLocalAndOfTheWideNetworkUnderKeysOfTheirOwn) {
    service.setOutcome(3, ping(true, true, statistics()));
    service.setOutcome(6, ping(true, true, statistics()));

    controller.runCurrentNetworkPingLANWithConfiguration(configuration, results);
    controller.runCurrentNetworkPingWANWithConfiguration(configuration, results);

    DictionaryPointer summary = Dictionary::make({{"SSID", "wlan0"},
                                                  {"count", 5},
                                                  {"packetLoss", 0.2},
                                                  {"min", 1.5},
                                                  {"max", 9.5},
                                                  {"avg", 4.25},
                                                  {"stddev", 0.5},
                                                  {"timestamp", "2001-01-01T00:00:00Z"}});
    EXPECT_EQ(results->entries(), (Entries{{"pingedLAN", true},
                                           {"pingLANResult", summary},
                                           {"pingedWAN", true},
                                           {"pingWANResult", summary}}));
}

TEST_F(PingTest, RecordsNoStatisticsOfAPingThatDidNotPass) {
    service.setOutcome(3, ping(false, false, statistics()));

    controller.runCurrentNetworkPingLANWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"pingedLAN", false}}));
    EXPECT_EQ(logLines(), Lines());
}

TEST_F(PingTest, RecordsTheStatisticsOfAPassedPingWithAFalseVerdict) {
    service.setOutcome(3, ping(false, true, statistics()));

    controller.runCurrentNetworkPingLANWithConfiguration(configuration, results);

    EXPECT_EQ(results->value("pingedLAN"), Value(false));
    EXPECT_TRUE(results->value("pingLANResult"));
}

TEST_F(PingTest, TurnsUnknownLossAverageAndDeviationIntoNull) {
    auto record = statistics();
    record->packetLoss = record->avg = record->stddev = std::nan("");

    DictionaryPointer summary = summaryOf(record);

    for (const char* key : {"packetLoss", "avg", "stddev"})
        EXPECT_EQ(summary->value(key), Value(NullMarker()));
    EXPECT_EQ(summary->size(), 8U);
}

TEST_F(PingTest, KeepsAnUnknownMinimumAndMaximumAsNumbers) {
    auto record = statistics();
    record->min = record->max = std::nan("");

    DictionaryPointer summary = summaryOf(record);

    for (const char* key : {"min", "max"}) {
        const std::optional<Value> value = summary->value(key);
        ASSERT_TRUE(value && value->as<double>()) << key;
        EXPECT_TRUE(std::isnan(*value->as<double>())) << key;
    }
}

TEST_F(PingTest, StoresNullForAMissingInterfaceName) {
    auto record = statistics();
    record->interfaceName.reset();

    DictionaryPointer summary = summaryOf(record);

    EXPECT_EQ(summary->value("SSID"), Value(NullMarker()));
    EXPECT_EQ(summary->size(), 8U);
}

TEST_F(PingTest, StoresTheCountAsASignedInteger) {
    EXPECT_NE(summaryOf(statistics())->value("count")->as<std::int64_t>(), nullptr);
}

TEST_F(PingTest, OverwritesBothKeysWhenItIsRunTwice) {
    summaryOf(statistics());
    auto later = statistics();
    later->count = 1;
    service.setOutcome(3, ping(false, true, later));

    controller.runCurrentNetworkPingLANWithConfiguration(configuration, results);

    EXPECT_EQ(results->value("pingedLAN"), Value(false));
    DictionaryPointer summary = *results->value("pingLANResult")->as<DictionaryPointer>();
    EXPECT_EQ(summary->value("count"), Value(1));
}

TEST_F(PingTest, LogsAPassedPingWithoutStatistics) {
    service.setOutcome(6, outcome(true, true, Dictionary::make()));

    controller.runCurrentNetworkPingWANWithConfiguration(configuration, results);

    EXPECT_EQ(results->entries(), (Entries{{"pingedWAN", true}}));
    EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: PingResult not found."});
}

}  // namespace
}  // namespace wp::rows
