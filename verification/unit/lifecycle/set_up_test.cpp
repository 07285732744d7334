#include <gtest/gtest.h>

#include "verification/unit/fakes/diagnostic_run.h"
#include "verification/unit/fakes/printing.h"

namespace wp {
namespace {

using fakes::DiagnosticRun;
using fakes::NetworkList;
using Entries = Dictionary::Entries;

TEST(SetUp, StartsWithEverythingAtItsBeginning) {
    DiagnosticRun run;

    EXPECT_EQ(run.controller->completedTests(), 0);
    EXPECT_FALSE(run.controller->refreshEnabled());
    EXPECT_FALSE(run.controller->progressScreenVisible());
    EXPECT_FALSE(run.controller->scanFinished());
    EXPECT_EQ(run.controller->wifiStatus(), nullptr);
    EXPECT_EQ(run.statusCode(), std::nullopt);
    EXPECT_FALSE(run.controller->isFinished());
}

TEST(SetUp, AsksNothingOfTheDevice) {
    DiagnosticRun run;

    EXPECT_EQ(run.device.service.statusQueries(), 0);
    EXPECT_EQ(run.device.service.requests().size(), 0U);
    EXPECT_EQ(run.device.wifi.calls().size(), 0U);
}

TEST(SetUp, BuildsTheConfigurationsOfTheCurrentNetworkAndOfAFreshScan) {
    DiagnosticRun run(NetworkList::hidden, "Office");

    EXPECT_EQ(run.controller->currentNetworkConfiguration()->entries(), (Entries{{"MaxScanCacheAge", 30u}}));
    EXPECT_EQ(run.controller->freshScanConfiguration()->entries(), (Entries{{"MaxScanCacheAge", 0}}));
    EXPECT_EQ(run.controller->configuration(), nullptr);
}

TEST(SetUp, MakesThreeEmptySections) {
    DiagnosticRun run;

    EXPECT_EQ(run.controller->deviceData()->size(), 0U);
    EXPECT_EQ(run.controller->currentNetworkData()->size(), 0U);
    EXPECT_EQ(run.controller->selectedNetworkData()->size(), 0U);
    EXPECT_NE(run.controller->currentNetworkData(), run.controller->selectedNetworkData());
    EXPECT_NE(run.controller->deviceData(), run.controller->currentNetworkData());
}

TEST(SetUp, PostsTheParametersToTestAutomationWhenThatIsEnabled) {
    fakes::FakeDevice device;
    device.automation.setEnabled(true);
    DictionaryPointer parameters = fakes::request(NetworkList::hidden, "Office");

    auto controller = fakes::controllerFor(device.platform, parameters);

    ASSERT_EQ(device.automation.posted().size(), 1U);
    DictionaryPointer posted = device.automation.posted().front();
    EXPECT_EQ(posted->entries(), (Entries{{"parameters", parameters},
                                          {"predicates", Dictionary::make()},
                                          {"specifications", Dictionary::make()}}));
    EXPECT_EQ(*posted->value("parameters")->as<DictionaryPointer>(), parameters);
}

TEST(SetUp, PostsNothingWithoutTestAutomation) {
    DiagnosticRun run;

    EXPECT_TRUE(run.device.automation.posted().empty());
}

TEST(Screen, ShowsTheStatusBarAndStandsUpright) {
    DiagnosticRun run;

    EXPECT_FALSE(run.controller->prefersStatusBarHidden());
    EXPECT_EQ(run.controller->supportedInterfaceOrientations(), 2U);
    EXPECT_EQ(run.controller->preferredInterfaceOrientationForPresentation(),
              ui::InterfaceOrientation::portrait);
}

}  // namespace
}  // namespace wp
