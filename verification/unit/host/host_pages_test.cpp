// The host's own pages: the one during a run without the list, and the last one of a run.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <map>

#include "host/closing_page.h"
#include "host/running_page.h"
#include "platform/activity.h"
#include "platform/main_queue.h"
#include "platform/ui/identifiers.h"
#include "verification/unit/fakes/fake_diagnostics_client.h"

namespace wp::host {
namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::HasSubstr;

/// Evidence of a joined network that works, with these entries in place of its own.
Evidence outcomeWith(Dictionary::Entries entries, std::int64_t statusCode = 0) {
    entries.merge(Dictionary::Entries{{"networkName", "Home"}, {"pingedWAN", true}, {"reachedVantor", true}});
    return evidenceFrom(statusCode,
                        Dictionary::make({{"currentNetwork", Dictionary::make(std::move(entries))}}));
}

std::shared_ptr<ClosingPage> pageOf(const Evidence& evidence, const char* language = "en") {
    static std::map<std::string, Texts> all;
    const Texts& texts = all.try_emplace(language, language).first->second;
    return std::make_shared<ClosingPage>(makeReport(evidence, {}, texts), texts);
}

/// A screen with a viewer who presses keys whenever the front end would wait for them.
class Viewer final : public ui::FrontEnd {
  public:
    bool runUntil(const std::function<bool()>& condition, std::optional<Clock::time_point> end) override {
        for (ui::Key key : keys) {
            if (condition()) return true;
            screen.press(key);
        }
        return queue.runUntil(condition, end);
    }
    bool takesKeys() const override { return isThere; }

    /// The lines of the table: titles in brackets, rows by themselves.
    std::vector<std::string> lines() {
        screen.layoutIfNeeded();
        std::vector<std::string> lines;
        ui::SettingsTableView& table = *screen.table();
        for (int section = 0; section < table.numberOfSections(); ++section) {
            if (table.titleForHeader(section)) lines.push_back("[" + *table.titleForHeader(section) + "]");
            for (int row = 0; row < table.numberOfRows(section); ++row) {
                auto cell = table.cellForRow({row, section});
                lines.push_back(cell->text());
                if (!cell->detailText().empty()) lines.push_back(cell->detailText());
            }
        }
        return lines;
    }
    std::string text(const char* identifier) { return screen.viewAs<ui::Label>(identifier)->text(); }

    Activity activity;
    MainQueue queue{activity};
    std::vector<std::string> notes;
    ui::Screen screen{[this](std::string_view note) { notes.emplace_back(note); }};
    std::vector<ui::Key> keys;
    bool isThere = true;
};

TEST(ClosingPage, TellsTheOutcomeAndTheThreeWorstFindingsWithWhatToDo) {
    Viewer viewer;
    viewer.screen.setRootViewController(pageOf(outcomeWith({{"isCaptive", true},
                                                            {"reachedVantor", false},
                                                            {"hasPoorSignal", true},
                                                            {"isBeaconIntervalLong", true},
                                                            {"isIPv6Assigned", false}})));

    std::vector<std::string> lines = viewer.lines();

    EXPECT_EQ(viewer.text(ui::identifiers::title), "The test is finished");
    EXPECT_THAT(viewer.text(ui::identifiers::description), HasSubstr("sign-in page"));
    EXPECT_EQ(viewer.text(ui::identifiers::status), "Close with OK or Back, or wait 60 seconds.");
    std::vector<std::string> titles;
    for (const std::string& line : lines)
        if (line.front() == '[') titles.push_back(line);
    EXPECT_THAT(titles, ElementsAre("[Does not work: Network “Home”]", "[Problem: Network “Home”]",
                                    "[Could be better: Network “Home”]"));
    EXPECT_EQ(lines[0], "Close");
    EXPECT_EQ(lines[2], "A sign-in page stands between this device and the Internet.");
    EXPECT_NE(lines[3].front(), '[') << "what to do";
    EXPECT_EQ(viewer.screen.table()->numberOfRows(1), 1) << "a finding is one row";
    EXPECT_TRUE(viewer.screen.layoutReport().conflicts.empty());
    EXPECT_TRUE(viewer.notes.empty());
}

TEST(ClosingPage, WithoutFindingsSaysSoAndOffersToClose) {
    Viewer viewer;
    viewer.screen.setRootViewController(pageOf(outcomeWith({})));

    EXPECT_EQ(viewer.text(ui::identifiers::description),
              "As far as this result tells, the network “Home” works, and no problem was found.");
    EXPECT_THAT(viewer.lines(), ElementsAre("Close"));
}

TEST(ClosingPage, SaysWhyARunEndedEarly) {
    std::set<std::string> sentences;
    for (int statusCode : {-2, -3, -4, -5, -7}) {
        Viewer viewer;
        viewer.screen.setRootViewController(pageOf(evidenceFrom(statusCode, Dictionary::make())));
        sentences.insert(viewer.text(ui::identifiers::description));
    }
    // No radio and no device are one and the same for a viewer.
    EXPECT_GE(sentences.size(), 3u);
    EXPECT_THAT(sentences, testing::Not(testing::Contains(HasSubstr("works"))));
}

TEST(ClosingPage, ShowsANameThatCouldSteerAScreenHarmlessly) {
    Viewer viewer;
    viewer.screen.setRootViewController(
        pageOf(outcomeWith({{"networkName", "a\x1B[2J\xE2\x80\xAE<b>"}, {"hasPoorSignal", true}})));

    std::string all = viewer.text(ui::identifiers::description);
    for (const std::string& line : viewer.lines()) all += line;

    EXPECT_THAT(viewer.text(ui::identifiers::description), HasSubstr("a\\x1B[2J\\u{202E}<b>"));
    EXPECT_EQ(all.find('\x1B'), std::string::npos);
    EXPECT_EQ(all.find("\xE2\x80\xAE"), std::string::npos);
}

TEST(ClosingPage, StandsInsideTheSafeAreaInEveryLanguage) {
    constexpr double kSafeBottom = 1026;
    for (const char* language : {"en", "de", "ja"}) {
        Viewer viewer;
        viewer.screen.setRootViewController(
            pageOf(outcomeWith({{"networkName", std::string(32, 'W')}, {"hasPoorSignal", true}}), language));
        viewer.screen.layoutIfNeeded();

        ui::View& status = *viewer.screen.view(ui::identifiers::status);
        EXPECT_LE(status.frameOnScreen().bottom(), kSafeBottom) << language;
        EXPECT_LE(status.frameOnScreen().right(), viewer.screen.table()->frameOnScreen().x) << language;
        EXPECT_EQ(viewer.screen.table()->frameOnScreen(), (ui::Rect{820, 162, 1000, 918}));
    }
}

TEST(ClosingPage, TheWayOutHasTheFocusAndEachFindingTheRoomThatItTakes) {
    Viewer viewer;
    viewer.screen.setRootViewController(
        pageOf(outcomeWith({{"isCaptive", true}, {"reachedVantor", false}, {"hasPoorSignal", true}})));
    viewer.screen.layoutIfNeeded();
    viewer.screen.focusPreferredView();
    ui::SettingsTableView& table = *viewer.screen.table();

    EXPECT_EQ(viewer.screen.focusedIndexPath(), (ui::IndexPath{0, 0}));
    EXPECT_EQ(table.rectForRow({0, 0}).height, ui::SettingsTableView::kRowHeight);
    ui::Rect finding = table.rectForRow({0, 1});
    EXPECT_EQ(finding.height, table.cellForRow({0, 1})->subtitleHeight(viewer.screen.textMeasurer(), 1000));
    EXPECT_GT(finding.height, ui::SettingsTableView::kRowHeight);
    EXPECT_EQ(table.rectForHeader(2).y, finding.bottom());
}

TEST(ClosingPage, TellsHowLongItStillStands) {
    Viewer viewer;
    std::shared_ptr<ClosingPage> page = pageOf(outcomeWith({}));
    viewer.screen.setRootViewController(page);

    page->showTimeLeft(15s);

    EXPECT_EQ(viewer.text(ui::identifiers::status), "Close with OK or Back, or wait 15 seconds.");
}

TEST(ClosingPage, ClosesByOKOnAnyRow) {
    Viewer viewer;
    viewer.keys = {ui::Key::down, ui::Key::select};
    std::shared_ptr<ClosingPage> page = pageOf(outcomeWith({{"hasPoorSignal", true}}));

    showClosingPage(page, viewer.screen, viewer, 1h, [] { return false; });

    EXPECT_TRUE(page->isClosed());
    EXPECT_EQ(viewer.screen.screenName(), "none");
}

TEST(ClosingPage, ClosesByBack) {
    Viewer viewer;
    viewer.keys = {ui::Key::back};
    std::shared_ptr<ClosingPage> page = pageOf(outcomeWith({}));

    showClosingPage(page, viewer.screen, viewer, 1h, [] { return false; });

    EXPECT_TRUE(page->isClosed());
}

TEST(ClosingPage, ClosesByItselfWhenTheTimeIsOver) {
    Viewer viewer;
    viewer.keys = {ui::Key::down, ui::Key::up};
    std::shared_ptr<ClosingPage> page = pageOf(outcomeWith({}));

    showClosingPage(page, viewer.screen, viewer, 1ms, [] { return false; });

    EXPECT_FALSE(page->isClosed());
    EXPECT_EQ(viewer.screen.screenName(), "none");
}

TEST(ClosingPage, GoesAtOnceWhenTheRunIsBrokenOffOrNobodyCanPressAKey) {
    Viewer viewer;
    std::shared_ptr<ClosingPage> page = pageOf(outcomeWith({}));

    showClosingPage(page, viewer.screen, viewer, 1h, [] { return true; });
    viewer.isThere = false;
    showClosingPage(page, viewer.screen, viewer, 1h, [] { return false; });

    EXPECT_FALSE(page->isClosed());
}

TEST(RunningPage, SaysWhichTestIsRunningInTheViewersLanguage) {
    Texts texts("de");
    auto page = std::make_shared<RunningPage>("WLAN-Diagnose", "Es wird geprüft.", texts);
    Viewer viewer;
    viewer.screen.setRootViewController(page);

    page->show({19, "Bluetooth devices", 6, 40});
    viewer.screen.layoutIfNeeded();

    EXPECT_EQ(viewer.text(ui::identifiers::title), "WLAN-Diagnose");
    EXPECT_EQ(viewer.text(ui::identifiers::description), "Es wird geprüft.");
    EXPECT_EQ(viewer.text(ui::identifiers::status), "Verbundene Bluetooth-Geräte (6 von 40)");
    auto* bar = viewer.screen.viewAs<ui::ProgressView>(ui::identifiers::progress);
    EXPECT_FLOAT_EQ(bar->progress(), 5.0F / 40);
    EXPECT_EQ(bar->frameOnScreen().x, 775);
    EXPECT_TRUE(viewer.notes.empty());
}

}  // namespace
}  // namespace wp::host
