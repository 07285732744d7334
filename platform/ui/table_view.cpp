#include "platform/ui/table_view.h"

#include <algorithm>

#include "platform/ui/screen.h"

namespace wp::ui {

void SettingsTableView::setDataSource(TableViewDataSource* dataSource) {
    dataSource_ = dataSource;
    loaded_ = false;
    setNeedsLayout();
}

int SettingsTableView::numberOfRows(int section) const {
    if (section < 0 || section >= numberOfSections()) return 0;
    return static_cast<int>(sections_[section].rows.size());
}

const std::optional<std::string>& SettingsTableView::titleForHeader(int section) const {
    static const std::optional<std::string> none;
    return section < 0 || section >= numberOfSections() ? none : sections_[section].title;
}

bool SettingsTableView::hasRow(IndexPath indexPath) const {
    return indexPath.row >= 0 && indexPath.row < numberOfRows(indexPath.section);
}

std::shared_ptr<TableViewCell> SettingsTableView::cellForRow(IndexPath indexPath) const {
    return hasRow(indexPath) ? sections_[indexPath.section].rows[indexPath.row] : nullptr;
}

void SettingsTableView::loadIfNeeded() {
    if (!loaded_) load();
}

void SettingsTableView::load() {
    loaded_ = true;
    selected_.reset();
    for (Section& section : sections_)
        for (auto& cell : section.rows) recycle(std::move(cell));
    sections_.clear();
    if (!dataSource_) return;
    sections_.resize(std::max(0, dataSource_->numberOfSectionsInTableView(*this)));
    for (int number = 0; number < numberOfSections(); ++number) {
        int rows = std::max(0, dataSource_->tableViewNumberOfRowsInSection(*this, number));
        sections_[number].rows.reserve(rows);
        for (int row = 0; row < rows; ++row)
            sections_[number].rows.push_back(
                dataSource_->tableViewCellForRowAtIndexPath(*this, {row, number}));
    }
    loadTitles();
}

void SettingsTableView::loadTitles() {
    for (int number = 0; number < numberOfSections(); ++number) {
        Section& section = sections_[number];
        section.title = dataSource_->tableViewTitleForHeaderInSection(*this, number);
        double header =
            delegate_ ? delegate_->tableViewHeightForHeaderInSection(*this, number) : kAutomaticDimension;
        double footer =
            delegate_ ? delegate_->tableViewHeightForFooterInSection(*this, number) : kAutomaticDimension;
        section.headerHeight = header >= 0 ? header : section.title ? kHeaderHeight : 0;
        section.footerHeight = footer >= 0 ? footer : 0;
    }
    measureRows();
}

void SettingsTableView::measureRows() {
    for (Section& section : sections_) {
        section.rowHeight = kRowHeight;
        if (section.rows.empty() || section.rows.front()->style() != TableViewCell::Style::subtitle) continue;
        for (const auto& cell : section.rows)
            section.rowHeight =
                std::max(section.rowHeight, cell->subtitleHeight(textMeasurer(), frame().width));
    }
}

void SettingsTableView::reloadData() {
    std::optional<IndexPath> before = focused_;
    auto cell = before ? cellForRow(*before) : nullptr;
    std::string text = cell ? cell->text() : "";
    pending_ = {};
    load();
    keepFocusThroughReload(before, text);
    changed();
    if (Screen* shown = screen()) shown->tableReloaded(*this);
}

void SettingsTableView::registerCellClass(CellFactory factory, const std::string& reuseIdentifier) {
    factories_[reuseIdentifier] = std::move(factory);
}

std::shared_ptr<TableViewCell> SettingsTableView::dequeueReusableCell(const std::string& reuseIdentifier,
                                                                      IndexPath /*indexPath*/) {
    auto free = std::find_if(freeCells_.rbegin(), freeCells_.rend(),
                             [&](const auto& cell) { return cell->reuseIdentifier() == reuseIdentifier; });
    if (free != freeCells_.rend()) {
        std::shared_ptr<TableViewCell> cell = std::move(*free);
        freeCells_.erase(std::next(free).base());
        cell->prepareForReuse();
        return cell;
    }
    auto factory = factories_.find(reuseIdentifier);
    if (factory != factories_.end()) return factory->second(TableViewCell::Style::standard, reuseIdentifier);
    return std::make_shared<TableViewCell>(TableViewCell::Style::standard, reuseIdentifier);
}

void SettingsTableView::recycle(std::shared_ptr<TableViewCell> cell) {
    // A front end that still plays the row's end may hold the cell: it keeps its text then.
    if (cell && cell.use_count() == 1) freeCells_.push_back(std::move(cell));
}

void SettingsTableView::deselectRow(IndexPath indexPath, Animated /*animated*/) {
    if (selected_ != indexPath) return;
    selected_.reset();
    if (auto cell = cellForRow(indexPath)) cell->setSelected(false);
}

void SettingsTableView::pressRow(IndexPath indexPath) {
    auto cell = cellForRow(indexPath);
    if (!allowsSelection_ || !cell || !cell->isUserInteractionEnabled()) return;
    selected_ = indexPath;
    cell->setSelected(true);
    if (delegate_) delegate_->tableViewDidSelectRowAtIndexPath(*this, indexPath);
}

double SettingsTableView::sectionTop(int section) const {
    double height = 0;
    for (int number = 0; number <= section && number < numberOfSections(); ++number) {
        const Section& next = sections_[number];
        if (height >= kHeaderHeight) height += gapAbove(next);
        if (number == section) break;
        height +=
            next.headerHeight + next.footerHeight + next.rowHeight * static_cast<double>(next.rows.size());
    }
    return contentInset_.top + height;
}

double SettingsTableView::gapAbove(const Section& section) const {
    bool isGroup = style_ == Style::grouped && !section.rows.empty();
    return isGroup && section.headerHeight < 1 ? kGroupGap : 0;
}

double SettingsTableView::contentHeight() const {
    return sectionTop(numberOfSections()) + contentInset_.bottom;
}

double SettingsTableView::lowestContentOffset() const {
    return std::max(0.0, contentHeight() - viewHeight());
}

Rect SettingsTableView::rectForHeader(int section) const {
    if (section < 0 || section >= numberOfSections()) return {};
    return {0, sectionTop(section), frame().width, sections_[section].headerHeight};
}

Rect SettingsTableView::rectForRow(IndexPath indexPath) const {
    if (!hasRow(indexPath)) return {};
    double height = sections_[indexPath.section].rowHeight;
    double top = rectForHeader(indexPath.section).bottom() + indexPath.row * height;
    return {0, top, frame().width, height};
}

std::vector<IndexPath> SettingsTableView::indexPathsForVisibleRows() const {
    std::vector<IndexPath> visible;
    // Rows may have gone since the last layout.
    double upperEdge = std::min(contentOffset_, lowestContentOffset());
    double lowerEdge = upperEdge + viewHeight();
    for (int section = 0; section < numberOfSections(); ++section) {
        double top = rectForHeader(section).bottom();
        double height = sections_[section].rowHeight;
        int first = std::max(0, static_cast<int>((upperEdge - top) / height));
        for (int row = first; row < numberOfRows(section); ++row) {
            double rowTop = top + row * height;
            if (rowTop >= lowerEdge) break;
            if (rowTop + height > upperEdge) visible.push_back({row, section});
        }
    }
    return visible;
}

void SettingsTableView::scrollToRow(IndexPath indexPath, ScrollPosition /*position*/, Animated animated) {
    layoutIfNeeded();
    if (!hasRow(indexPath) || viewHeight() <= 0) return;
    Rect row = rectForRow(indexPath);
    // The row above, or the section's title, is seen as well, so that nobody takes the row for the first.
    double top = row.y - kHeaderHeight;
    double wanted = contentOffset_;
    if (row.bottom() + contentInset_.bottom > wanted + viewHeight())
        wanted = row.bottom() + contentInset_.bottom - viewHeight();
    if (top < wanted) wanted = top;
    wanted = std::clamp(wanted, 0.0, lowestContentOffset());
    if (wanted == contentOffset_) return;
    contentOffset_ = wanted;
    changed();
    if (Screen* shown = screen()) shown->tableScrolled(*this, animated);
}

void SettingsTableView::layoutSubviews() {
    loadIfNeeded();
    measureRows();
    contentOffset_ = std::min(contentOffset_, lowestContentOffset());
}

}  // namespace wp::ui
