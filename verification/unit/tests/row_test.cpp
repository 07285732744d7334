#include "verification/unit/tests/catalogue_fixture.h"

namespace wp::rows {
namespace {

using fakes::failure;
using fakes::outcome;
using Entries = Dictionary::Entries;
using Lines = std::vector<std::string>;

Value verdict(const Row& row, bool result) {
    // The scan test alone writes a number, and the other way round.
    if (row.testID == 31) return result ? 0 : 1;
    return result;
}

bool opens(Gate gate, bool didPass) {
    return gate == Gate::always || (gate == Gate::passed && didPass) || (gate == Gate::notPassed && !didPass);
}

/// An outcome for which the row's gate is open.
DiagnosticsTestResponse openOutcome(const Row& row, bool result, DictionaryPointer info) {
    return outcome(result, row.gate != Gate::notPassed, std::move(info));
}

DictionaryPointer sampleInfo(const Row& row) {
    return row.infoKey ? Dictionary::make({{row.infoKey, sampleInformation(row)}}) : Dictionary::make();
}

TEST_P(CatalogueRowTest, AsksForItsOwnTestInARequestListOfOne) {
    run(GetParam());

    EXPECT_EQ(service.requestedTestIDs(), std::vector{GetParam().testID});
    EXPECT_EQ(service.requestListLengths(), std::vector<std::size_t>{1});
}

TEST_P(CatalogueRowTest, PassesTheConfigurationOnAsItIs) {
    run(GetParam());

    DictionaryPointer wanted = GetParam().deviceOperation ? controller.configuration() : configuration;
    EXPECT_EQ(service.requests().front().configuration, wanted);
    EXPECT_EQ(configuration->entries(), (Entries{{"MaxScanCacheAge", 30u}, {"NetworkName", "Office"}}));
}

TEST_P(CatalogueRowTest, StoresTheVerdictWhateverItIs) {
    for (bool result : {true, false}) {
        service.setOutcome(GetParam().testID, outcome(result, result));

        run(GetParam());

        EXPECT_EQ(written(GetParam())->value(GetParam().resultKey), verdict(GetParam(), result));
    }
}

TEST_P(CatalogueRowTest, StoresTheVerdictWhenTheTestDidNotPass) {
    service.setOutcome(GetParam().testID, outcome(true, false));

    run(GetParam());

    EXPECT_EQ(written(GetParam())->value(GetParam().resultKey), verdict(GetParam(), true));
}

TEST_P(CatalogueRowTest, ReadsTheInformationOnlyThroughItsGate) {
    for (bool didPass : {true, false}) {
        DictionaryPointer section = written(GetParam());
        for (const auto& entry : section->entries()) section->removeValue(entry.first);
        controller.setWifiScanResults(nullptr);
        service.setOutcome(GetParam().testID, outcome(true, didPass, sampleInfo(GetParam())));

        run(GetParam());

        bool isStored = GetParam().infoResultKey ? section->value(GetParam().infoResultKey).has_value()
                                                 : controller.wifiScanResults() != nullptr;
        EXPECT_EQ(isStored, opens(GetParam().gate, didPass)) << "didPass " << didPass;
        EXPECT_EQ(section->value(GetParam().resultKey), verdict(GetParam(), true));
    }
}

TEST_P(CatalogueRowTest, LogsNothingAboutInformationBehindAClosedGate) {
    for (bool didPass : {true, false}) {
        if (opens(GetParam().gate, didPass)) continue;
        service.setOutcome(GetParam().testID, outcome(true, didPass));

        run(GetParam());

        EXPECT_EQ(logLines(), Lines());
        EXPECT_EQ(written(GetParam())->entries(),
                  (Entries{{GetParam().resultKey, verdict(GetParam(), true)}}));
    }
}

TEST_P(CatalogueRowTest, WritesNothingOnAServiceErrorAndLogsItByItsName) {
    DiagnosticsTestResponse response = openOutcome(GetParam(), true, sampleInfo(GetParam()));
    response.error = Error{7, "no such device"};
    service.setOutcome(GetParam().testID, response);

    run(GetParam());

    EXPECT_EQ(written(GetParam())->entries(), Entries());
    EXPECT_EQ(logLines(), Lines{GetParam().failureLine + std::string("no such device (code 7)")});
}

TEST_P(CatalogueRowTest, TakesAnErrorOfCodeZeroForSuccess) {
    DiagnosticsTestResponse response = openOutcome(GetParam(), true, sampleInfo(GetParam()));
    response.error = Error{0, "all is well"};
    service.setOutcome(GetParam().testID, response);

    run(GetParam());

    EXPECT_EQ(written(GetParam())->value(GetParam().resultKey), verdict(GetParam(), true));
}

TEST_P(CatalogueRowTest, WritesNothingWithoutResults) {
    for (const auto& response :
         {DiagnosticsTestResponse{}, DiagnosticsTestResponse{DiagnosticsTestResults{}, {}}}) {
        device.log.clear();
        service.setOutcome(GetParam().testID, response);

        run(GetParam());

        EXPECT_EQ(written(GetParam())->entries(), Entries());
        EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: Results not found."});
    }
}

TEST_P(CatalogueRowTest, WritesNothingWhenTheFirstResultIsAbsent) {
    auto second = std::make_shared<const DiagnosticsTestResult>();
    service.setOutcome(GetParam().testID, {DiagnosticsTestResults{nullptr, second}, std::nullopt});

    run(GetParam());

    EXPECT_EQ(written(GetParam())->entries(), Entries());
    EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: Test Result not found."});
}

TEST_P(CatalogueRowTest, UsesOnlyTheFirstOfTwoResults) {
    DiagnosticsTestResponse response = outcome(true, true, sampleInfo(GetParam()));
    response.results->push_back(std::make_shared<const DiagnosticsTestResult>());
    service.setOutcome(GetParam().testID, response);

    run(GetParam());

    EXPECT_EQ(written(GetParam())->value(GetParam().resultKey), verdict(GetParam(), true));
}

TEST_P(CatalogueRowTest, LogsAbsentInformationAndKeepsTheVerdict) {
    if (GetParam().gate == Gate::never) return;
    service.setOutcome(GetParam().testID, openOutcome(GetParam(), true, nullptr));

    run(GetParam());

    EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: Info not found."});
    EXPECT_EQ(written(GetParam())->entries(), (Entries{{GetParam().resultKey, verdict(GetParam(), true)}}));
}

TEST_P(CatalogueRowTest, LogsAMissingValueByItsNameAndLeavesItsKeyAsItWas) {
    if (GetParam().gate == Gate::never) return;
    if (GetParam().infoResultKey)
        written(GetParam())->setValue(GetParam().infoResultKey, "of an earlier run");
    service.setOutcome(GetParam().testID,
                       openOutcome(GetParam(), true, Dictionary::make({{"SomethingElse", 1}})));

    run(GetParam());

    Lines lines = logLines();
    if (GetParam().missingLine) {
        ASSERT_FALSE(lines.empty());
        EXPECT_EQ(lines.front(), GetParam().missingLine);
    } else {
        EXPECT_EQ(lines, Lines());
    }
    EXPECT_EQ(written(GetParam())->value(GetParam().resultKey), verdict(GetParam(), true));
    if (GetParam().infoResultKey) {
        EXPECT_EQ(written(GetParam())->value(GetParam().infoResultKey), Value("of an earlier run"));
    }
}

TEST_P(CatalogueRowTest, OverwritesAnEarlierRunAndKeepsWhatALaterOneDoesNotReach) {
    service.setOutcome(GetParam().testID, openOutcome(GetParam(), true, sampleInfo(GetParam())));
    run(GetParam());
    Entries first = written(GetParam())->entries();

    service.setOutcome(GetParam().testID, failure(5, "gone"));
    run(GetParam());
    EXPECT_EQ(written(GetParam())->entries(), first);

    service.setOutcome(GetParam().testID, openOutcome(GetParam(), false, sampleInfo(GetParam())));
    run(GetParam());
    EXPECT_EQ(written(GetParam())->value(GetParam().resultKey), verdict(GetParam(), false));
}

TEST_P(CatalogueRowTest, FormatsNoLineWhileErrorsAreNotKept) {
    device.log.setErrorEnabled(false);
    service.setOutcome(GetParam().testID, failure(7, "no such device"));

    run(GetParam());

    EXPECT_EQ(device.log.lines(), std::vector<fakes::RecordingLog::Line>());
}

TEST_P(CatalogueRowTest, WritesOnlyItsOwnSection) {
    service.setOutcome(GetParam().testID, openOutcome(GetParam(), true, sampleInfo(GetParam())));

    run(GetParam());

    EXPECT_EQ(controller.currentNetworkData()->size(), 0U);
    EXPECT_EQ(controller.selectedNetworkData()->size(), 0U);
    if (GetParam().networkOperation) {
        EXPECT_EQ(controller.deviceData()->size(), 0U);
    }
}

TEST_P(CatalogueRowTest, LeavesTheProgressAlone) {
    run(GetParam());

    EXPECT_EQ(controller.completedTests(), 0);
}

INSTANTIATE_TEST_SUITE_P(EveryTest, CatalogueRowTest, ::testing::ValuesIn(allRows()),
                         [](const auto& test) { return test.param.name; });

/// The rows whose value goes into the document as the service delivered it.
class PlainRowTest : public CatalogueRowTest {};

std::vector<Row> plainRows() {
    std::vector<Row> rows;
    for (const Row& row : allRows()) {
        bool isPlain = row.infoKey && sampleInformation(row).as<std::string>();
        if (isPlain) rows.push_back(row);
    }
    return rows;
}

TEST_P(PlainRowTest, StoresTheValueAsDeliveredWhateverItsKind) {
    auto record = std::make_shared<WiFiChannel>(1);
    DictionaryPointer dictionary = Dictionary::make({{"a", 1}});
    const Value values[] = {"text",       true,    42,     std::uint64_t{7}, 2.5,
                            NullMarker(), Date{1}, record, dictionary,       Array{"802.11ac", "802.11n"}};
    for (const Value& value : values) {
        service.setOutcome(GetParam().testID,
                           openOutcome(GetParam(), true, Dictionary::make({{GetParam().infoKey, value}})));

        run(GetParam());

        EXPECT_EQ(written(GetParam())->value(GetParam().infoResultKey), value);
    }
}

TEST_P(PlainRowTest, StoresTheVeryObject) {
    DictionaryPointer dictionary = Dictionary::make({{"a", 1}});
    service.setOutcome(GetParam().testID,
                       openOutcome(GetParam(), true, Dictionary::make({{GetParam().infoKey, dictionary}})));

    run(GetParam());

    EXPECT_EQ(*written(GetParam())->value(GetParam().infoResultKey)->as<DictionaryPointer>(), dictionary);
}

INSTANTIATE_TEST_SUITE_P(EveryTest, PlainRowTest, ::testing::ValuesIn(plainRows()),
                         [](const auto& test) { return test.param.name; });

TEST_F(CatalogueTest, HasElevenDeviceTestsAndThirtyNetworkTestsWithAnIDEach) {
    std::set<int> testIDs;
    for (const Row& row : allRows()) testIDs.insert(row.testID);

    EXPECT_EQ(deviceRows().size(), 11U);
    EXPECT_EQ(networkRows().size(), 30U);
    EXPECT_EQ(testIDs.size(), 41U);
}

}  // namespace
}  // namespace wp::rows
