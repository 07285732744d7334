// Batches: several changes as one, checked against the data source before anything is taken over.

#include <algorithm>
#include <sstream>

#include "platform/ui/screen.h"
#include "platform/ui/table_view.h"

namespace wp::ui {
namespace {

bool isIn(const std::vector<IndexPath>& sorted, IndexPath path) {
    return std::binary_search(sorted.begin(), sorted.end(), path);
}

/// Sorts; false when a path stands there twice.
bool sortUnique(std::vector<IndexPath>& paths) {
    std::sort(paths.begin(), paths.end());
    return std::adjacent_find(paths.begin(), paths.end()) == paths.end();
}

void append(std::vector<IndexPath>& paths, const std::vector<IndexPath>& more) {
    paths.insert(paths.end(), more.begin(), more.end());
}

std::string place(IndexPath path) {
    return "row " + std::to_string(path.row) + " of section " + std::to_string(path.section);
}

}  // namespace

struct SettingsTableView::Plan {
    static constexpr int kInserted = -1;

    /// For each new row the old row that it is, or `kInserted`.
    std::vector<int> sources;
    /// For each old row the new one that it becomes, or -1.
    std::vector<int> targets;
    std::vector<std::shared_ptr<TableViewCell>> cells;
};

void SettingsTableView::beginUpdates() {
    ++depth_;
}

void SettingsTableView::endUpdates() {
    if (depth_ > 0 && --depth_ == 0) applyBatch();
}

void SettingsTableView::insertRows(const std::vector<IndexPath>& newPositions, RowAnimation) {
    beginUpdates();
    append(pending_.insertions, newPositions);
    endUpdates();
}

void SettingsTableView::deleteRows(const std::vector<IndexPath>& oldPositions, RowAnimation) {
    beginUpdates();
    append(pending_.deletions, oldPositions);
    endUpdates();
}

void SettingsTableView::reloadRows(const std::vector<IndexPath>& oldPositions, RowAnimation) {
    beginUpdates();
    append(pending_.reloads, oldPositions);
    endUpdates();
}

void SettingsTableView::applyBatch() {
    if (!dataSource_) {
        pending_ = {};
        return;
    }
    // A table that has never shown anything has no rows that could be changed.
    if (!loaded_) return reloadData();
    std::vector<Plan> plans(sections_.size());
    std::string fault = planBatch(plans);
    if (fault.empty()) fault = takeCells(plans);
    if (!fault.empty()) return repair(fault);

    std::optional<IndexPath> focus = focusAfter(plans);
    if (selected_) {
        int row = hasRow(*selected_) ? plans[selected_->section].targets[selected_->row] : -1;
        selected_ = row >= 0 ? std::optional(IndexPath{row, selected_->section}) : std::nullopt;
    }
    TableChanges changes = std::move(pending_);
    pending_ = {};
    for (IndexPath& path : changes.reloads) path.row = plans[path.section].targets[path.row];
    for (int number = 0; number < numberOfSections(); ++number) {
        std::swap(sections_[number].rows, plans[number].cells);
        for (auto& cell : plans[number].cells) recycle(std::move(cell));
    }
    changes.titlesChanged = titlesAreNew();
    bool isFocusLost = focused_ && !focus;
    focused_ = focused_ ? focus : focused_;
    if (!changes.isEmpty()) changed();
    if (Screen* shown = screen()) {
        if (!changes.isEmpty()) shown->tableChanged(*this, changes);
        if (isFocusLost || !focused_) focusPreferredRow();
        showFocusedRow();
        shown->focusChanged();
    }
}

bool SettingsTableView::titlesAreNew() {
    std::vector<std::optional<std::string>> before;
    for (const Section& section : sections_) before.push_back(section.title);
    loadTitles();
    for (std::size_t i = 0; i < before.size(); ++i)
        if (before[i] != sections_[i].title) return true;
    return false;
}

/// Works out what becomes of each row. Returns what does not fit together, empty when all does.
std::string SettingsTableView::planBatch(std::vector<Plan>& plans) {
    bool isUnique = sortUnique(pending_.deletions);
    isUnique = sortUnique(pending_.insertions) && isUnique;
    if (!isUnique) return "a row is deleted or inserted twice";
    sortUnique(pending_.reloads);
    pending_.reloads.erase(std::unique(pending_.reloads.begin(), pending_.reloads.end()),
                           pending_.reloads.end());
    for (IndexPath path : pending_.deletions)
        if (!hasRow(path)) return "there is no " + place(path) + " to delete";
    for (IndexPath path : pending_.reloads)
        if (!hasRow(path)) return "there is no " + place(path) + " to reload";
    std::erase_if(pending_.reloads, [this](IndexPath path) { return isIn(pending_.deletions, path); });
    if (dataSource_->numberOfSectionsInTableView(*this) != numberOfSections())
        return "the number of sections is another";
    for (int section = 0; section < numberOfSections(); ++section) {
        std::string fault = planSection(section, plans[section]);
        if (!fault.empty()) return fault;
    }
    return {};
}

std::string SettingsTableView::planSection(int section, Plan& plan) {
    auto inSection = [section](IndexPath path) { return path.section == section; };
    auto count = [&](const std::vector<IndexPath>& paths) {
        return static_cast<int>(std::count_if(paths.begin(), paths.end(), inSection));
    };
    int before = numberOfRows(section);
    int deleted = count(pending_.deletions);
    int inserted = count(pending_.insertions);
    int after = dataSource_->tableViewNumberOfRowsInSection(*this, section);
    if (before - deleted + inserted != after) {
        std::ostringstream out;
        out << "section " << section << " has " << after << " rows where " << before << " - " << deleted
            << " + " << inserted << " were expected";
        return out.str();
    }
    plan.sources.assign(after, Plan::kInserted);
    plan.targets.assign(before, -1);
    for (int old = 0, now = 0; old < before; ++old) {
        if (isIn(pending_.deletions, {old, section})) continue;
        while (isIn(pending_.insertions, {now, section})) ++now;
        if (now >= after) return "a row is inserted beyond the end of section " + std::to_string(section);
        plan.targets[old] = now;
        plan.sources[now] = old;
        ++now;
    }
    for (IndexPath path : pending_.insertions)
        if (inSection(path) && (path.row < 0 || path.row >= after))
            return "a row is inserted beyond the end of section " + std::to_string(section);
    return {};
}

/// Asks for every row's cell. Kept rows keep theirs; that the data source still means the same row by it is
/// checked by its text, since names that differ only in case may have changed places.
std::string SettingsTableView::takeCells(std::vector<Plan>& plans) {
    for (int section = 0; section < numberOfSections(); ++section) {
        Plan& plan = plans[section];
        plan.cells.reserve(plan.sources.size());
        for (int row = 0; row < static_cast<int>(plan.sources.size()); ++row) {
            auto cell = dataSource_->tableViewCellForRowAtIndexPath(*this, {row, section});
            int source = plan.sources[row];
            if (source == Plan::kInserted || isIn(pending_.reloads, {source, section})) {
                plan.cells.push_back(std::move(cell));
                continue;
            }
            const auto& kept = sections_[section].rows[source];
            if (kept->text() != cell->text())
                return place({row, section}) + " is no longer the row that was kept there";
            plan.cells.push_back(kept);
            recycle(std::move(cell));
        }
    }
    return {};
}

/// Where the focus goes: with its row; from a row that is gone to the row now in its place, else to the one
/// before; to nothing where there is neither. A row that is deleted and inserted again is the row now in its
/// place.
std::optional<IndexPath> SettingsTableView::focusAfter(const std::vector<Plan>& plans) const {
    if (!focused_ || !hasRow(*focused_)) return std::nullopt;
    const Plan& plan = plans[focused_->section];
    int target = plan.targets[focused_->row];
    if (target >= 0) return IndexPath{target, focused_->section};

    const std::string& text = cellForRow(*focused_)->text();
    for (std::size_t row = 0; row < plan.cells.size(); ++row)
        if (plan.sources[row] == Plan::kInserted && plan.cells[row]->text() == text)
            return IndexPath{static_cast<int>(row), focused_->section};

    // The place is the one that the row had among the rows that stay.
    int start = 0;
    int offset = 0;
    for (int old = focused_->row - 1; old >= 0 && start == 0; --old) {
        if (plan.targets[old] >= 0) {
            start = plan.targets[old] + 1;
        } else {
            ++offset;
        }
    }
    int count = static_cast<int>(plan.cells.size());
    int limit = count - 1;
    for (int old = focused_->row + 1; old < static_cast<int>(plan.targets.size()); ++old) {
        if (plan.targets[old] < 0) continue;
        limit = plan.targets[old];
        break;
    }
    int row = std::min(start + offset, limit);
    if (row >= 0) return IndexPath{row, focused_->section};
    for (int section = focused_->section - 1; section >= 0; --section)
        if (int rows = static_cast<int>(plans[section].cells.size())) return IndexPath{rows - 1, section};
    return std::nullopt;
}

void SettingsTableView::repair(const std::string& reason) {
    ++repairs_;
    if (Screen* shown = screen()) shown->note("table: " + reason + "; reloaded");
    reloadData();
}

}  // namespace wp::ui
