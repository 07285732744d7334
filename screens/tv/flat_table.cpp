#include "screens/tv/flat_table.h"

#include <algorithm>

#include "platform/ui/display_text.h"

namespace wp::tv {
namespace {

// What asks for no visible room.
constexpr double kNoRoom = 0.5;

Line headerOf(const ui::SettingsTableView& table, int section) {
    Line line;
    line.section = section;
    line.text = ui::displayForm(table.titleForHeader(section).value_or(""));
    ui::Rect place = table.rectForHeader(section);
    line.top = place.y;
    line.height = place.height;
    return line;
}

Line rowOf(const ui::SettingsTableView& table, ui::IndexPath path) {
    Line line;
    line.section = path.section;
    line.row = path.row;
    const ui::TableViewCell& cell = *table.cellForRow(path);
    line.text = ui::displayForm(cell.text());
    line.detail = ui::displayForm(cell.detailText());
    line.isBlock = cell.style() == ui::TableViewCell::Style::subtitle;
    line.isEnabled = cell.isUserInteractionEnabled();
    line.isFirst = path.row == 0;
    line.isLast = path.row == table.numberOfRows(path.section) - 1;
    ui::Rect place = table.rectForRow(path);
    line.top = place.y;
    line.height = place.height;
    return line;
}

std::vector<Line> linesOf(const ui::SettingsTableView& table) {
    std::vector<Line> lines;
    for (int section = 0; section < table.numberOfSections(); ++section) {
        Line header = headerOf(table, section);
        if (header.height > kNoRoom) lines.push_back(std::move(header));
        for (int row = 0; row < table.numberOfRows(section); ++row)
            lines.push_back(rowOf(table, {row, section}));
    }
    return lines;
}

bool holds(const std::vector<ui::IndexPath>& paths, const Line& line) {
    return !line.isHeader() &&
           std::binary_search(paths.begin(), paths.end(), ui::IndexPath{line.row, line.section});
}

/// Pairs what stays, in order: the n-th staying old line is the n-th staying new one.
template <class Goes, class Comes>
LineChanges changesOf(const std::vector<Line>& before, const std::vector<Line>& after, Goes goes,
                      Comes comes) {
    LineChanges changes;
    for (int old = static_cast<int>(before.size()) - 1; old >= 0; --old)
        if (goes(before[static_cast<std::size_t>(old)])) changes.removals.push_back(old);
    for (int now = 0; now < static_cast<int>(after.size()); ++now)
        if (comes(after[static_cast<std::size_t>(now)])) changes.insertions.push_back(now);
    return changes;
}

bool hasHeader(const std::vector<Line>& lines, int section) {
    return std::any_of(lines.begin(), lines.end(),
                       [&](const Line& line) { return line.isHeader() && line.section == section; });
}

/// Whether the two may be one line before and after a reload.
bool isSame(const Line& before, const Line& after) {
    return before.section == after.section && before.isHeader() == after.isHeader() &&
           (before.isHeader() || before.text == after.text);
}

}  // namespace

LineChanges FlatTable::apply(const ui::SettingsTableView& table, const ui::TableChanges& batch) {
    std::vector<Line> after = linesOf(table);
    auto goes = [&](const Line& line) {
        return line.isHeader() ? !hasHeader(after, line.section) : holds(batch.deletions, line);
    };
    auto comes = [&](const Line& line) {
        return line.isHeader() ? !hasHeader(lines_, line.section) : holds(batch.insertions, line);
    };
    LineChanges changes = changesOf(lines_, after, goes, comes);
    bool isWhole = lines_.size() - changes.removals.size() + changes.insertions.size() == after.size();
    if (!isWhole) return reload(table);
    lines_ = std::move(after);
    return changes;
}

LineChanges FlatTable::reload(const ui::SettingsTableView& table) {
    std::vector<Line> after = linesOf(table);
    LineChanges changes;
    std::size_t old = 0;
    std::vector<bool> stays(lines_.size(), false);
    for (std::size_t now = 0; now < after.size(); ++now) {
        std::size_t match = old;
        while (match < lines_.size() && !isSame(lines_[match], after[now])) ++match;
        if (match == lines_.size()) {
            changes.insertions.push_back(static_cast<int>(now));
        } else {
            stays[match] = true;
            old = match + 1;
        }
    }
    for (std::size_t gone = lines_.size(); gone-- > 0;)
        if (!stays[gone]) changes.removals.push_back(static_cast<int>(gone));
    lines_ = std::move(after);
    return changes;
}

LineChanges FlatTable::clear() {
    LineChanges changes;
    for (int old = static_cast<int>(lines_.size()) - 1; old >= 0; --old) changes.removals.push_back(old);
    lines_.clear();
    return changes;
}

void FlatTable::refresh(const ui::SettingsTableView& table) {
    std::vector<Line> now = linesOf(table);
    if (now.size() == lines_.size()) lines_ = std::move(now);
}

}  // namespace wp::tv
