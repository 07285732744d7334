#include <gtest/gtest.h>

#include "network_list/scan_list.h"
#include "verification/unit/network_list/list_run.h"

namespace wp {
namespace {

using namespace fakes;
using ui::Key;

TEST(ProgressScreen, DimsAndFreezesTheListAndShowsItsMessage) {
    ListRun run;
    run.join("Home", "1");
    run.hear({{"Cafe", "2"}});
    run.showList();

    run.controller->showProgress();

    EXPECT_EQ(run.controller->tableView()->alpha(), 0.5);
    EXPECT_TRUE(run.controller->descriptionLabel()->isHidden());
    EXPECT_FALSE(run.controller->progressView()->isHidden());
    EXPECT_FALSE(run.controller->mainLabel()->isHidden());
    EXPECT_EQ(run.controller->mainLabel()->text(), "text of PROGRESS_TEXT");
    for (const char* row : {"Home", "Cafe", "OTHER", "REFRESH"}) {
        run.choose(row);
        EXPECT_EQ(run.alert(), "no alert");
    }
    EXPECT_EQ(run.device.queues.readyInBackground(), 0u);
}

TEST(ProgressScreen, BeforeThereAreViewsChangesNothingVisible) {
    DiagnosticRun run;

    run.controller->showProgress();

    EXPECT_TRUE(run.controller->progressScreenVisible());
    EXPECT_EQ(run.controller->tableView(), nullptr);
}

TEST(ProgressScreen, OfARunWithoutTheListKeepsItsBarHiddenAndTheSelectedRowFocused) {
    DiagnosticRun run;
    run.device.service.setJoinedNetwork("Home", "1");
    run.device.screen.setRootViewController(run.controller);

    run.controller->start();

    EXPECT_EQ(run.device.screen.screenName(), "progress");
    EXPECT_TRUE(run.controller->progressView()->isHidden());
    EXPECT_TRUE(run.controller->mainLabel()->isHidden());
    EXPECT_FALSE(run.controller->descriptionLabel()->isHidden());
    EXPECT_EQ(picture(run.device.screen), "(SELECTED_NETWORK) >Home / (CHOOSE_NETWORK) / ~OTHER / ~REFRESH");
    run.device.screen.setRootViewController(nullptr);
}

TEST(ProgressScreen, OfARunWithoutTheListLetsASecondConfirmationDoNothing) {
    DiagnosticRun run;
    run.device.service.setJoinedNetwork("Home", "1");
    run.device.screen.setRootViewController(run.controller);
    run.controller->start();

    run.device.screen.press(Key::select);
    EXPECT_NE(run.device.screen.alert(), nullptr);
    run.device.screen.press(Key::select);
    run.device.queues.runAll();

    EXPECT_EQ(run.controller->completedTests(), 40);
    EXPECT_EQ(run.statusCode(), 0);
    run.device.screen.setRootViewController(nullptr);
}

TEST(ProgressBar, MovesInElevenStepsToTheEnd) {
    DiagnosticRun run;
    run.device.screen.setRootViewController(run.controller);
    std::vector<float> fractions;
    run.device.service.setRequestHandler([&](const DiagnosticsTestRequest&) {
        run.device.queues.runMain();
        fractions.push_back(run.controller->progressView()->progress());
    });

    run.runToEnd();

    ASSERT_EQ(fractions.size(), 11u);
    for (int done = 0; done < 11; ++done)
        EXPECT_EQ(fractions[done], static_cast<float>(done) / 11.0F) << done;
    EXPECT_EQ(run.controller->progressView()->progress(), 1.0F);
    run.device.screen.setRootViewController(nullptr);
}

TEST(ProgressBar, ReadsItsCountersWhenItsBlockRuns) {
    DiagnosticRun run;
    run.controller->setupViewWithNetworkList(false);
    std::vector<float> fractions;
    run.controller->start();
    run.device.queues.runBackground();  // all eleven tests: eleven updates wait behind one another

    while (run.device.queues.runOneOnMain()) fractions.push_back(run.controller->progressView()->progress());

    EXPECT_EQ(fractions, std::vector<float>(11, 1.0F));
}

TEST(StandAloneProgressScreen, TakesTheListAwayAndBuildsItsOwnLabelAndBar) {
    ListRun run;
    run.hear({{"Cafe", "2"}});
    run.showList();
    auto table = run.controller->tableView();
    auto oldLabel = run.controller->mainLabel();

    run.controller->displayProgressScreen();

    EXPECT_TRUE(run.controller->progressScreenVisible());
    EXPECT_EQ(table->superview(), nullptr);
    ui::Label& label = *run.controller->mainLabel();
    EXPECT_NE(&label, oldLabel.get());
    EXPECT_EQ(label.frame(), ui::Rect{});
    EXPECT_FALSE(label.isOpaque());
    EXPECT_EQ(static_cast<int>(label.contentMode()), 7);
    EXPECT_EQ(label.contentHuggingPriority(ui::Axis::horizontal), 251);
    EXPECT_EQ(label.contentHuggingPriority(ui::Axis::vertical), 251);
    EXPECT_EQ(label.textAlignment(), ui::TextAlignment::center);
    EXPECT_EQ(label.lineBreakMode(), ui::LineBreakMode::byWordWrapping);
    EXPECT_EQ(label.numberOfLines(), 3);
    EXPECT_EQ(static_cast<int>(label.baselineAdjustment()), 2);
    EXPECT_EQ(label.preferredMaxLayoutWidth(), 280);
    EXPECT_EQ(label.font(), ui::Font::system(27));
    EXPECT_EQ(label.text(), "text of PROGRESS_TEXT");
    EXPECT_EQ(label.textColor(), ui::Color::black());
    EXPECT_TRUE(label.isLaidOutByConstraints());
    ui::ProgressView& bar = *run.controller->progressView();
    EXPECT_EQ(bar.style(), ui::ProgressView::Style::standard);
    EXPECT_EQ(bar.progress(), 0);
    EXPECT_EQ(bar.contentHuggingPriority(ui::Axis::vertical), 750);
    EXPECT_TRUE(bar.isLaidOutByConstraints());
    EXPECT_TRUE(run.controller->view()->needsUpdateConstraints());
    const auto& views = run.controller->view()->subviews();
    ASSERT_GE(views.size(), 2u);
    EXPECT_EQ(views[views.size() - 2].get(), &label);
    EXPECT_EQ(views.back().get(), &bar);
}

}  // namespace
}  // namespace wp
