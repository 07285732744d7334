#include "host/closing_page.h"

#include <algorithm>

namespace wp::host {
namespace {

// Left of the table, with air between the two.
constexpr double kLeading = 90;
constexpr double kColumnWidth = 640;
constexpr double kTableWidth = 1000;
// The time that is left is told in steps that nobody is hurried by.
constexpr std::chrono::seconds kStep{5};
constexpr const char* kCloseCell = "close";
constexpr const char* kFindingCell = "finding";

}  // namespace

ClosingPage::ClosingPage(const Report& report, const Texts& texts)
    : HostPage(texts.text("CLOSING_TITLE"), report.summary, {kLeading, kColumnWidth}), texts_(texts) {
    progress().setHidden(true);
    showTimeLeft(kClosingPageTime);
    // The way out comes first: it has the focus, and nothing that is below it has scrolled away.
    sections_.push_back({std::nullopt, texts.text("CLOSING_CLOSE"), {}});
    for (const ReportedFinding& finding : closingSummary(report).findings) addFinding(finding);
    ui::SettingsTableView& table = addTable(kTableWidth);
    table.registerCellClass(
        [](ui::TableViewCell::Style, const std::string& identifier) {
            return std::make_shared<ui::TableViewCell>(ui::TableViewCell::Style::subtitle, identifier);
        },
        kFindingCell);
    table.setDataSource(this);
    table.setDelegate(this);
    table.reloadData();
}

void ClosingPage::addFinding(const ReportedFinding& finding) {
    std::string title = texts_.text(
        "CLOSING_FINDING", {{"severity", severityText(finding.severity, texts_)}, {"where", finding.where}});
    sections_.push_back({std::move(title), finding.what, finding.advice});
}

void ClosingPage::showTimeLeft(std::chrono::seconds left) {
    status().setText(texts_.text("CLOSING_HINT", {{"seconds", std::to_string(left.count())}}));
}

int ClosingPage::numberOfSectionsInTableView(ui::SettingsTableView&) {
    return static_cast<int>(sections_.size());
}

int ClosingPage::tableViewNumberOfRowsInSection(ui::SettingsTableView&, int) {
    return 1;
}

std::optional<std::string> ClosingPage::tableViewTitleForHeaderInSection(ui::SettingsTableView&,
                                                                         int section) {
    return sections_[static_cast<std::size_t>(section)].title;
}

std::shared_ptr<ui::TableViewCell> ClosingPage::tableViewCellForRowAtIndexPath(ui::SettingsTableView& table,
                                                                               ui::IndexPath path) {
    const Section& section = sections_[static_cast<std::size_t>(path.section)];
    std::shared_ptr<ui::TableViewCell> cell =
        table.dequeueReusableCell(section.title ? kFindingCell : kCloseCell, path);
    cell->setText(section.text);
    cell->setDetailText(section.detail);
    return cell;
}

double ClosingPage::tableViewHeightForHeaderInSection(ui::SettingsTableView&, int) {
    return ui::SettingsTableView::kAutomaticDimension;
}

double ClosingPage::tableViewHeightForFooterInSection(ui::SettingsTableView&, int) {
    return ui::SettingsTableView::kSmallestPositive;
}

void showClosingPage(const std::shared_ptr<ClosingPage>& page, ui::Screen& screen, ui::FrontEnd& frontEnd,
                     std::chrono::milliseconds time, const std::function<bool()>& isBrokenOff) {
    screen.setBackHandler([page] { page->close(); });
    screen.setRootViewController(page);
    screen.focusPreferredView();
    auto isOver = [&] { return page->isClosed() || isBrokenOff() || !frontEnd.takesKeys(); };
    const auto end = ui::FrontEnd::Clock::now() + time;
    for (auto now = end - time; now < end; now = ui::FrontEnd::Clock::now()) {
        // Whole steps, so that the last one says five seconds and not how little is left of them.
        auto steps = std::chrono::ceil<std::chrono::seconds>(end - now) / kStep;
        if (steps > 0) page->showTimeLeft(steps * kStep);
        if (frontEnd.runUntil(isOver, std::min(end, now + kStep))) break;
    }
    screen.setBackHandler(nullptr);
    screen.setRootViewController(nullptr);
}

}  // namespace wp::host
