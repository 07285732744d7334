#include "host/closing_page.h"

#include "host/report/wrapping.h"

namespace wp::host {
namespace {

// Left of the table, with air between the two.
constexpr double kLeading = 90;
constexpr double kColumnWidth = 640;
constexpr double kTableWidth = 1000;
// A row holds one line; this many columns fit into the table and into the smallest terminal window.
constexpr int kRowColumns = 48;

void append(std::vector<std::string>& rows, const std::string& text) {
    for (std::string& line : wrappedLines(text, kRowColumns)) rows.push_back(std::move(line));
}

}  // namespace

ClosingPage::ClosingPage(const Report& report, const Texts& texts)
    : HostPage(texts.text("CLOSING_TITLE"), report.summary, {kLeading, kColumnWidth}) {
    progress().setHidden(true);
    status().setText(texts.text("CLOSING_HINT", {{"seconds", std::to_string(kClosingPageTime.count())}}));
    for (const ReportedFinding& finding : closingSummary(report).findings) addFinding(finding, texts);
    sections_.push_back({std::nullopt, {texts.text("CLOSING_CLOSE")}});
    ui::SettingsTableView& table = addTable(kTableWidth);
    table.setDataSource(this);
    table.setDelegate(this);
    table.reloadData();
}

void ClosingPage::addFinding(const ReportedFinding& finding, const Texts& texts) {
    Section section;
    section.title = texts.text(
        "CLOSING_FINDING", {{"severity", severityText(finding.severity, texts)}, {"where", finding.where}});
    append(section.rows, finding.what);
    append(section.rows, finding.advice);
    sections_.push_back(std::move(section));
}

int ClosingPage::numberOfSectionsInTableView(ui::SettingsTableView&) {
    return static_cast<int>(sections_.size());
}

int ClosingPage::tableViewNumberOfRowsInSection(ui::SettingsTableView&, int section) {
    return static_cast<int>(sections_[static_cast<std::size_t>(section)].rows.size());
}

std::optional<std::string> ClosingPage::tableViewTitleForHeaderInSection(ui::SettingsTableView&,
                                                                         int section) {
    return sections_[static_cast<std::size_t>(section)].title;
}

std::shared_ptr<ui::TableViewCell> ClosingPage::tableViewCellForRowAtIndexPath(ui::SettingsTableView& table,
                                                                               ui::IndexPath path) {
    std::shared_ptr<ui::TableViewCell> cell = table.dequeueReusableCell("line", path);
    const Section& section = sections_[static_cast<std::size_t>(path.section)];
    cell->setText(section.rows[static_cast<std::size_t>(path.row)]);
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
    frontEnd.runUntil(isOver, ui::FrontEnd::Clock::now() + time);
    screen.setBackHandler(nullptr);
    screen.setRootViewController(nullptr);
}

}  // namespace wp::host
