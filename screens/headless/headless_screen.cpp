#include "screens/headless/headless_screen.h"

#include <algorithm>

namespace wp::headless {
namespace {

std::size_t index(int number) {
    return static_cast<std::size_t>(number);
}

std::string textAt(const ui::SettingsTableView& table, ui::IndexPath path) {
    auto cell = table.cellForRow(path);
    return cell ? cell->text() : "";
}

}  // namespace

HeadlessScreen::HeadlessScreen(ui::Screen& screen, MainQueue& queue) : screen_(screen), queue_(queue) {
    screen_.setTextMeasurer(nullptr);
    screen_.setObserver(this);
}

HeadlessScreen::~HeadlessScreen() {
    screen_.setObserver(nullptr);
}

bool HeadlessScreen::runUntil(const std::function<bool()>& condition, std::optional<Clock::time_point> end) {
    auto isFulfilled = [&] {
        draw();
        return condition();
    };
    return queue_.runUntil(isFulfilled, end);
}

void HeadlessScreen::draw() {
    if (isUpToDate_) return;
    screen_.layoutIfNeeded();
    // The first layout loads a table without a word.
    if (screen_.table() != mirrored_) adopt(screen_.table());
    isUpToDate_ = true;
}

void HeadlessScreen::adopt(const ui::SettingsTableView* table) {
    mirrored_ = table;
    rows_ = table ? rowsOf(*table) : Rows();
}

HeadlessScreen::Rows HeadlessScreen::rowsOf(const ui::SettingsTableView& table) {
    Rows rows(index(table.numberOfSections()));
    for (int section = 0; section < table.numberOfSections(); ++section)
        for (int row = 0; row < table.numberOfRows(section); ++row)
            rows[index(section)].push_back(textAt(table, {row, section}));
    return rows;
}

void HeadlessScreen::tableReloaded(ui::SettingsTableView& table) {
    isUpToDate_ = false;
    adopt(&table);
}

void HeadlessScreen::tableChanged(ui::SettingsTableView& table, const ui::TableChanges& changes) {
    isUpToDate_ = false;
    if (mirrored_ == &table && apply(table, changes) && rows_ == rowsOf(table)) return;
    if (mirrored_ == &table) ++faults_;
    adopt(&table);
}

/// Plays the changes on the mirror; false when one of them names a row that cannot be.
bool HeadlessScreen::apply(const ui::SettingsTableView& table, const ui::TableChanges& changes) {
    auto holds = [&](ui::IndexPath path, std::size_t extra) {
        return path.row >= 0 && path.section >= 0 && index(path.section) < rows_.size() &&
               index(path.row) < rows_[index(path.section)].size() + extra;
    };
    for (auto path = changes.deletions.rbegin(); path != changes.deletions.rend(); ++path) {
        if (!holds(*path, 0)) return false;
        rows_[index(path->section)].erase(rows_[index(path->section)].begin() + path->row);
    }
    for (ui::IndexPath path : changes.insertions) {
        if (!holds(path, 1)) return false;
        auto& rows = rows_[index(path.section)];
        rows.insert(rows.begin() + path.row, textAt(table, path));
    }
    for (ui::IndexPath path : changes.reloads) {
        if (!holds(path, 0)) return false;
        rows_[index(path.section)][index(path.row)] = textAt(table, path);
    }
    return true;
}

}  // namespace wp::headless
