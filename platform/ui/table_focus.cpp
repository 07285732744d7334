// Which row of a table has the focus, and what becomes of it when rows come and go.

#include <algorithm>

#include "platform/ui/screen.h"
#include "platform/ui/table_view.h"

namespace wp::ui {

void SettingsTableView::setFocused(std::optional<IndexPath> indexPath) {
    if (focused_ == indexPath) return;
    focused_ = indexPath;
    changed();
    if (Screen* shown = screen()) shown->focusChanged();
}

void SettingsTableView::focusRow(IndexPath indexPath) {
    if (!hasRow(indexPath)) return;
    if (delegate_ && !delegate_->tableViewCanFocusRowAtIndexPath(*this, indexPath)) return;
    setFocused(indexPath);
    showFocusedRow();
}

void SettingsTableView::showFocusedRow() {
    if (focused_) scrollToRow(*focused_, ScrollPosition::none, Animated::yes);
}

std::optional<IndexPath> SettingsTableView::rowBefore(IndexPath indexPath) const {
    int row = indexPath.row - 1;
    for (int section = indexPath.section; section >= 0; --section) {
        if (row >= 0 && numberOfRows(section) > 0)
            return IndexPath{std::min(row, numberOfRows(section) - 1), section};
        row = section > 0 ? numberOfRows(section - 1) - 1 : -1;
    }
    return std::nullopt;
}

void SettingsTableView::moveFocus(int direction) {
    loadIfNeeded();
    if (!focused_) return focusPreferredRow();
    auto canFocus = [&](IndexPath path) {
        return !delegate_ || delegate_->tableViewCanFocusRowAtIndexPath(*this, path);
    };
    IndexPath path = *focused_;
    for (;;) {
        if (direction < 0) {
            auto before = rowBefore(path);
            if (!before) return;
            path = *before;
        } else {
            ++path.row;
            while (path.row >= numberOfRows(path.section)) {
                if (++path.section >= numberOfSections()) return;
                path.row = 0;
            }
        }
        if (canFocus(path)) return focusRow(path);
    }
}

void SettingsTableView::focusPreferredRow() {
    loadIfNeeded();
    std::optional<IndexPath> preferred;
    if (delegate_) preferred = delegate_->indexPathForPreferredFocusedViewInTableView(*this);
    if (preferred && hasRow(*preferred)) return focusRow(*preferred);
    if (focused_) return;
    for (int section = 0; section < numberOfSections() && !focused_; ++section) focusRow({0, section});
}

void SettingsTableView::keepFocusThroughReload(std::optional<IndexPath> before, const std::string& text) {
    Screen* shown = screen();
    bool isFree = !before || (shown && !shown->hasKeyBeenPressed());
    if (isFree) {
        if (before && !hasRow(*before)) setFocused(std::nullopt);
        if (shown) focusPreferredRow();
        return;
    }
    auto isItsRow = [&](IndexPath path) {
        auto cell = cellForRow(path);
        return cell && cell->text() == text;
    };
    std::optional<IndexPath> kept;
    if (isItsRow(*before)) kept = before;
    for (int row = 0; !kept && row < numberOfRows(before->section); ++row)
        if (isItsRow({row, before->section})) kept = IndexPath{row, before->section};
    if (!kept) kept = hasRow(*before) ? before : rowBefore(*before);
    setFocused(kept);
    kept ? showFocusedRow() : focusPreferredRow();
}

}  // namespace wp::ui
