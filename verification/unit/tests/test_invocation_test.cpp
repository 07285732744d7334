#include "verification/unit/tests/catalogue_fixture.h"

namespace wp::rows {
namespace {

using Lines = std::vector<std::string>;

TEST_F(CatalogueTest, TakesTheFirstOfTheResults) {
    auto first = std::make_shared<const DiagnosticsTestResult>();
    auto second = std::make_shared<const DiagnosticsTestResult>();

    EXPECT_EQ(controller.testResultFromResults(DiagnosticsTestResults{first, second}), first);
    EXPECT_EQ(logLines(), Lines());
}

TEST_F(CatalogueTest, SaysThatThereAreNoResultsWhenTheArrayIsEmptyOrAbsent) {
    EXPECT_EQ(controller.testResultFromResults(DiagnosticsTestResults{}), nullptr);
    EXPECT_EQ(controller.testResultFromResults(std::nullopt), nullptr);

    const std::string line = "[ERROR] - Wi-Fi Profile: Results not found.";
    EXPECT_EQ(logLines(), (Lines{line, line}));
}

TEST_F(CatalogueTest, SaysThatTheFirstResultIsAbsent) {
    EXPECT_EQ(controller.testResultFromResults(DiagnosticsTestResults{nullptr}), nullptr);

    EXPECT_EQ(logLines(), Lines{"[ERROR] - Wi-Fi Profile: Test Result not found."});
}

TEST_F(CatalogueTest, LogsToTheCategoryOfTheTests) {
    controller.testResultFromResults(std::nullopt);

    EXPECT_EQ(device.log.lines().front().first, 3);
}

TEST_F(CatalogueTest, PassesAnAbsentConfigurationOn) {
    controller.runCurrentNetworkPasspointWithConfiguration(nullptr, results);

    EXPECT_EQ(service.requests().front().configuration, nullptr);
    EXPECT_EQ(results->value("isPasspointNetwork"), Value(false));
}

TEST_F(CatalogueTest, TreatsAnErrorTextAsTextAndNotAsAFormat) {
    service.setOutcome(45, fakes::failure(-3, "%@ %s 100%"));

    controller.runCurrentNetworkPasspointWithConfiguration(configuration, results);

    EXPECT_EQ(logLines(),
              Lines{"[ERROR] - Wi-Fi Profile: Passpoint failed with error: %@ %s 100% (code -3)"});
}

}  // namespace
}  // namespace wp::rows
