#include <gtest/gtest.h>

#include "network_list/scan_list.h"
#include "network_list/wifi_header_view.h"
#include "network_list/wifi_table_view_cell.h"
#include "verification/unit/network_list/list_run.h"

namespace wp {
namespace {

using namespace fakes;
using ui::Rect;
namespace ids = ui::identifiers;

struct BuiltScreen : ::testing::Test {
    ListRun run;

    /// Builds the screen with a description of so many lines.
    void build(int lines = 1) {
        std::string text = "one";
        for (int line = 1; line < lines; ++line) text += "\nmore";
        run.device.localization.setText("WIFI_DESCRIPTION", text);
        run.controller->setupViewWithNetworkList(false);
        run.device.screen.layoutIfNeeded();
    }
    Rect frame(const char* identifier) { return run.device.screen.view(identifier)->frameOnScreen(); }
};

TEST_F(BuiltScreen, SolvesItsConstraintsToExactFrames) {
    build();

    EXPECT_EQ(frame(ids::table), (Rect{1060, 162, 760, 918}));
    EXPECT_EQ(frame("imageArea"), (Rect{90, 180, 870, 654}));
    EXPECT_EQ(frame(ids::description), (Rect{90, 834, 870, 34}));
    EXPECT_EQ(frame(ids::progress), (Rect{340, 887, 370, 10}));
    EXPECT_EQ(frame(ids::status).width, 870);
    EXPECT_EQ(frame("navigationBar"), (Rect{0, 0, 1920, 145}));
    EXPECT_EQ(frame(ids::title), (Rect{90, 57, 1740, 67}));
    EXPECT_EQ(frame(ids::image), (Rect{405, 387, 240, 240}));
    const ui::LayoutReport& report = run.device.screen.layoutReport();
    EXPECT_TRUE(report.conflicts.empty());
    EXPECT_TRUE(report.ambiguous.empty());
}

TEST_F(BuiltScreen, HasTwentySixConstraints) {
    build();

    auto count = [](auto& self, const ui::View& view) -> std::size_t {
        std::size_t sum = view.constraints().size();
        for (const auto& subview : view.subviews()) sum += self(self, *subview);
        return sum;
    };
    EXPECT_EQ(count(count, *run.controller->view()), 26u);
}

struct DescriptionLines {
    int lines;
    double progressTop;
    double statusBottom;
};

class ScreenWithADescription : public BuiltScreen, public ::testing::WithParamInterface<DescriptionLines> {};

TEST_P(ScreenWithADescription, MovesProgressAndStatusDownWithItsLines) {
    build(GetParam().lines);
    run.controller->showProgress();
    run.device.screen.layoutIfNeeded();

    EXPECT_EQ(frame(ids::progress).y, GetParam().progressTop);
    EXPECT_EQ(frame(ids::status).bottom(), GetParam().statusBottom);
    EXPECT_TRUE(run.device.screen.view(ids::description)->isHidden());
}

INSTANTIATE_TEST_SUITE_P(Lines, ScreenWithADescription,
                         ::testing::Values(DescriptionLines{1, 887, 942}, DescriptionLines{2, 921, 976},
                                           DescriptionLines{3, 955, 1010}, DescriptionLines{4, 989, 1044},
                                           DescriptionLines{5, 1023, 1078}, DescriptionLines{6, 1023, 1078}));

TEST_F(BuiltScreen, StylesItsViews) {
    build();
    ui::Label& description = *run.controller->descriptionLabel();
    ui::Label& status = *run.controller->mainLabel();
    ui::Label& title = *run.controller->navigationBarLabel();

    EXPECT_EQ(description.font(), ui::Font::body());
    EXPECT_EQ(description.numberOfLines(), 5);
    EXPECT_TRUE(description.adjustsFontSizeToFitWidth());
    EXPECT_EQ(description.lineBreakMode(), ui::LineBreakMode::byTruncatingTail);
    EXPECT_EQ(description.textColor(), ui::Color::white(0, 0.6));
    EXPECT_EQ(description.textAlignment(), ui::TextAlignment::center);
    EXPECT_EQ(description.text(), "one");
    EXPECT_EQ(status.numberOfLines(), 1);
    EXPECT_EQ(status.textColor(), description.textColor());
    EXPECT_TRUE(status.isHidden());
    EXPECT_FALSE(description.isHidden());
    EXPECT_EQ(title.font(), ui::Font::title2());
    EXPECT_EQ(title.numberOfLines(), 1);
    EXPECT_EQ(title.textColor(), ui::Color::white(0, 0.4));
    EXPECT_EQ(title.textAlignment(), ui::TextAlignment::center);
    EXPECT_TRUE(run.controller->progressView()->isHidden());
    EXPECT_EQ(run.controller->progressView()->progress(), 0);
    EXPECT_EQ(run.controller->progressView()->trackColor(), ui::Color::lightGray());
    auto* image = run.device.screen.viewAs<ui::ImageView>(ids::image);
    EXPECT_EQ(image->imageName(), "wifi");
    EXPECT_EQ(image->kind(), ui::ImageView::Kind::vibrant);
}

TEST_F(BuiltScreen, KeepsItsMeasuresAndTheTableThatTheArgumentDoesNotAskFor) {
    build();

    ui::SettingsTableView& table = *run.controller->tableView();
    EXPECT_EQ(run.controller->tableViewWidth(), 760);
    EXPECT_EQ(run.controller->tableViewPadding(), (ui::EdgeInsets{162, 0, 0, 100}));
    EXPECT_EQ(run.controller->tableViewContentInsets(), (ui::EdgeInsets{0, 0, 60, 0}));
    EXPECT_EQ(table.contentInset(), (ui::EdgeInsets{0, 0, 60, 0}));
    EXPECT_EQ(table.style(), ui::SettingsTableView::Style::grouped);
    EXPECT_FALSE(run.controller->automaticallyAdjustsScrollViewInsets());
    EXPECT_TRUE(run.controller->isFirstResponder());
    auto cell = table.dequeueReusableCell("cellIdentifier", {0, 2});
    EXPECT_EQ(std::dynamic_pointer_cast<WiFiTableViewCell>(cell), nullptr);
    EXPECT_EQ(run.list(), " / (CHOOSE_NETWORK) / >OTHER / ~REFRESH");
}

TEST_F(BuiltScreen, NamesTheDeviceWiFiUnlessItSaysWLAN) {
    build();
    EXPECT_EQ(run.controller->navigationBarLabel()->text(), "text of WIFI_DIAGNOSTICS");

    ListRun other;
    other.device.capabilities.add("wapi");
    other.controller->setupViewWithNetworkList(true);
    EXPECT_EQ(other.controller->navigationBarLabel()->text(), "text of WLAN_DIAGNOSTICS");
}

TEST_F(BuiltScreen, PaintsTheViewThatWasThereBeforeWhite) {
    auto before = run.controller->view();

    build();

    EXPECT_EQ(before->backgroundColor(), ui::Color::white());
    EXPECT_NE(run.controller->view(), before);
}

TEST(Controller, AnswersForStatusBarAndOrientationAsFixed) {
    ListRun run;

    EXPECT_FALSE(run.controller->prefersStatusBarHidden());
    EXPECT_FALSE(run.controller->shouldAutorotate());
    EXPECT_EQ(run.controller->supportedInterfaceOrientations(), 2u);
    EXPECT_EQ(static_cast<int>(run.controller->preferredInterfaceOrientationForPresentation()), 1);
    run.controller->view()->setNeedsUpdateConstraints();
    run.controller->updateViewConstraints();
    EXPECT_FALSE(run.controller->view()->needsUpdateConstraints());
}

TEST(Controller, SaysWhichScreenItShows) {
    ListRun run;
    EXPECT_EQ(run.device.screen.screenName(), "none");
    run.controller->setupViewWithNetworkList(true);
    EXPECT_EQ(run.device.screen.screenName(), "list");
    run.controller->showProgress();
    EXPECT_EQ(run.device.screen.screenName(), "progress");
}

// With the fixed measures a character of 13 points is 6.5 wide and a line 16 high.
TEST(HeaderView, WithoutASpinnerPlacesItsLabelAtTheLeftInset) {
    WiFiHeaderView header({0, 0, 700, 40}, "NETWORKS", false);

    EXPECT_EQ(header.headerText()->frame(), (Rect{18, 10, 52, 16}));
    EXPECT_EQ(header.spinner(), nullptr);
    EXPECT_EQ(header.headerText()->font(), ui::Font::system(13));
    EXPECT_EQ(header.headerText()->textColor(), ui::Color::white(0.4));
    EXPECT_EQ(header.headerText()->backgroundColor(), ui::Color::clear());
    EXPECT_EQ(header.backgroundColor(), ui::Color::clear());
    EXPECT_EQ(header.autoresizingMask(), 2u);
}

TEST(HeaderView, PlacesItsSpinnerBesideTheTextAndALittleHigher) {
    WiFiHeaderView header({0, 0, 700, 40}, "NETWORKS", true);

    EXPECT_EQ(header.spinner()->frame(), (Rect{18 + 52 + 10, 8, 16, 16}));
    EXPECT_EQ(header.spinner()->style(), ui::ActivityIndicator::Style::gray);
    EXPECT_FALSE(header.spinner()->isAnimating());
}

TEST(HeaderView, InATableStandsInsideTheTablesGround) {
    auto table = std::make_shared<ui::SettingsTableView>(Rect{}, ui::SettingsTableView::Style::grouped);
    auto header = std::make_shared<WiFiHeaderView>(Rect{0, 0, 700, 40}, "NETWORKS", true);

    table->addSubview(header);
    table->layoutIfNeeded();
    EXPECT_EQ(header->headerText()->frame().x, 18);

    table->setBackgroundInset(20);
    header->setNeedsLayout();
    table->layoutIfNeeded();
    EXPECT_EQ(header->headerText()->frame(), (Rect{35, 10, 52, 16}));
    EXPECT_EQ(header->spinner()->frame(), (Rect{35 + 52 + 10, 8, 16, 16}));
}

TEST(ListCell, HasItsTitleLeftAndItsDetailRightWhateverStyleItIsAskedFor) {
    WiFiTableViewCell cell(ui::TableViewCell::Style::standard, "cellIdentifier");
    cell.setFrame({0, 0, 400, 66});
    cell.setText("left");
    cell.setDetailText("right");

    EXPECT_EQ(cell.style(), ui::TableViewCell::Style::value1);
    EXPECT_EQ(cell.reuseIdentifier(), "cellIdentifier");
    EXPECT_EQ(cell.textFrame(), (Rect{20, 0, 260, 66}));
    EXPECT_EQ(cell.detailTextFrame(), (Rect{300, 0, 80, 66}));
}

}  // namespace
}  // namespace wp
