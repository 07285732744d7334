#pragma once

#include <functional>
#include <limits>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/ui/index_path.h"
#include "platform/ui/table_view_cell.h"
#include "platform/ui/view.h"

namespace wp::ui {

class SettingsTableView;

/// What a table shows. Asked only inside a reload or at the end of an outermost batch. *Main*.
class TableViewDataSource {
  public:
    virtual ~TableViewDataSource() = default;
    virtual int numberOfSectionsInTableView(SettingsTableView& tableView) = 0;
    virtual int tableViewNumberOfRowsInSection(SettingsTableView& tableView, int section) = 0;
    /// Nothing: the section has no title.
    virtual std::optional<std::string> tableViewTitleForHeaderInSection(SettingsTableView& tableView,
                                                                        int section) = 0;
    /// Never null.
    virtual std::shared_ptr<TableViewCell> tableViewCellForRowAtIndexPath(SettingsTableView& tableView,
                                                                          IndexPath indexPath) = 0;
};

/// How a table looks and behaves. *Main*.
class TableViewDelegate {
  public:
    virtual ~TableViewDelegate() = default;
    virtual double tableViewHeightForHeaderInSection(SettingsTableView& tableView, int section) = 0;
    virtual double tableViewHeightForFooterInSection(SettingsTableView& tableView, int section) = 0;
    virtual void tableViewDidSelectRowAtIndexPath(SettingsTableView& tableView, IndexPath indexPath) = 0;
    virtual bool tableViewCanFocusRowAtIndexPath(SettingsTableView& tableView, IndexPath indexPath) = 0;
    /// The row that should take the focus when nothing else says which; nothing: none in particular.
    virtual std::optional<IndexPath> indexPathForPreferredFocusedViewInTableView(
        SettingsTableView& tableView) = 0;
};

/// One outermost batch as a front end plays it: deletions, then insertions, in one turn. A row that is
/// reloaded stays the row that it was.
struct TableChanges {
    std::vector<IndexPath> deletions;   ///< old positions, ascending
    std::vector<IndexPath> insertions;  ///< new positions, ascending
    std::vector<IndexPath> reloads;     ///< new positions, ascending
    bool titlesChanged = false;
    bool isEmpty() const {
        return deletions.empty() && insertions.empty() && reloads.empty() && !titlesChanged;
    }
};

/// A table of rows in titled sections, with batches and focus. It draws from its own rows: the data source
/// may change freely between reloads and batches. When its rows and the data source's disagree at the end of
/// a batch it reloads once, says so in one note and counts the repair. *Main*.
class SettingsTableView : public View {
  public:
    enum class Style { plain = 0, grouped = 1 };
    enum class ScrollPosition { none = 0 };
    using CellFactory =
        std::function<std::shared_ptr<TableViewCell>(TableViewCell::Style, const std::string&)>;

    /// As a header's or footer's height: the table decides.
    static constexpr double kAutomaticDimension = -1;
    /// As a header's or footer's height: takes no visible room. 0 would mean automatic to older tables.
    static constexpr double kSmallestPositive = std::numeric_limits<double>::min();
    /// What a remote control's viewer reads and hits: text of 32 points with air around it. Where the first row of
    /// a section is of the style `subtitle`, all rows of it are as high as the one that takes most.
    static constexpr double kRowHeight = 66;
    /// Automatic height of a header with a title.
    static constexpr double kHeaderHeight = 66;
    /// In the grouped style: from the rows of one section to those of the next where no title stands between.
    static constexpr double kGroupGap = 30;

    SettingsTableView(Rect frame, Style style) : View(frame), style_(style) {}

    Style style() const { return style_; }
    /// Neither is kept alive.
    void setDataSource(TableViewDataSource* dataSource);
    void setDelegate(TableViewDelegate* delegate) { delegate_ = delegate; }
    TableViewDataSource* dataSource() const { return dataSource_; }
    TableViewDelegate* delegate() const { return delegate_; }

    /// @name Rows as they are shown
    /// @{
    int numberOfSections() const { return static_cast<int>(sections_.size()); }
    /// 0 for a section that there is not.
    int numberOfRows(int section) const;
    const std::optional<std::string>& titleForHeader(int section) const;
    /// Null for a row that there is not.
    std::shared_ptr<TableViewCell> cellForRow(IndexPath indexPath) const;
    bool hasRow(IndexPath indexPath) const;
    /// @}

    /// @name Changes
    /// @{
    /// Asks the data source for everything anew. The focus stays on its row; as long as no key was pressed it
    /// goes to the preferred one.
    void reloadData();
    /// Batches nest; the outermost end applies all changes of the batch. Outside a batch a single change is a
    /// batch of its own.
    void beginUpdates();
    void endUpdates();
    void insertRows(const std::vector<IndexPath>& newPositions, RowAnimation animation);
    void deleteRows(const std::vector<IndexPath>& oldPositions, RowAnimation animation);
    void reloadRows(const std::vector<IndexPath>& oldPositions, RowAnimation animation);
    /// How often rows and data source disagreed. 0 in a healthy program.
    int repairs() const { return repairs_; }
    /// @}

    /// @name Cells
    /// @{
    void registerCellClass(CellFactory factory, const std::string& reuseIdentifier);
    template <class Cell>
    void registerCellClass(const std::string& reuseIdentifier) {
        registerCellClass(
            [](TableViewCell::Style style, const std::string& identifier) {
                return std::make_shared<Cell>(style, identifier);
            },
            reuseIdentifier);
    }
    /// A cell of the class registered for the identifier, one that is free or a new one; a plain cell where
    /// none is registered.
    std::shared_ptr<TableViewCell> dequeueReusableCell(const std::string& reuseIdentifier,
                                                       IndexPath indexPath);
    /// @}

    /// @name Selection and focus
    /// @{
    bool allowsSelection() const { return allowsSelection_; }
    void setAllowsSelection(bool allows) { set(allowsSelection_, allows); }
    std::optional<IndexPath> indexPathForSelectedRow() const { return selected_; }
    void deselectRow(IndexPath indexPath, Animated animated);
    /// What the select key does on a row: nothing while selection is off or the row takes no touches.
    void pressRow(IndexPath indexPath);

    /// The row that has the table's focus, also while an alert has the keys; nothing in an empty table.
    std::optional<IndexPath> lastFocusedIndexPath() const { return focused_; }
    /// Nothing happens for a row that there is not, or that cannot have the focus.
    void focusRow(IndexPath indexPath);
    /// Up (-1) or down (1) through all rows of all sections; stops at the ends.
    void moveFocus(int direction);
    /// Gives the focus to the preferred row where there is one, else to the first when none has it.
    void focusPreferredRow();
    /// @}

    /// @name Geometry
    /// @{
    const EdgeInsets& contentInset() const { return contentInset_; }
    void setContentInset(EdgeInsets inset) { set(contentInset_, inset); }
    /// From the table's edge to the rounded ground of its rows; nothing in a table without one.
    std::optional<double> backgroundInset() const { return backgroundInset_; }
    void setBackgroundInset(std::optional<double> inset) { backgroundInset_ = inset; }
    double contentOffset() const { return contentOffset_; }
    double contentHeight() const;
    /// In content coordinates: the table shows them from the content offset on.
    Rect rectForRow(IndexPath indexPath) const;
    Rect rectForHeader(int section) const;
    std::vector<IndexPath> indexPathsForVisibleRows() const;
    /// Scrolls as little as it takes for the row to be seen with what is next to it; nothing happens for a row
    /// that there is not.
    void scrollToRow(IndexPath indexPath, ScrollPosition position, Animated animated);
    void layoutSubviews() override;
    /// @}

  private:
    struct Section {
        std::optional<std::string> title;
        double headerHeight = 0;
        double footerHeight = 0;
        double rowHeight = kRowHeight;  ///< of each of its rows
        std::vector<std::shared_ptr<TableViewCell>> rows;
    };
    /// What one section becomes, worked out before anything changes.
    struct Plan;

    void loadIfNeeded();
    void load();
    void loadTitles();
    void measureRows();
    bool titlesAreNew();
    void applyBatch();
    std::string planBatch(std::vector<Plan>& plans);
    std::string planSection(int section, Plan& plan);
    std::string takeCells(std::vector<Plan>& plans);
    void repair(const std::string& reason);
    void recycle(std::shared_ptr<TableViewCell> cell);
    void setFocused(std::optional<IndexPath> indexPath);
    void keepFocusThroughReload(std::optional<IndexPath> before, const std::string& text);
    std::optional<IndexPath> focusAfter(const std::vector<Plan>& plans) const;
    std::optional<IndexPath> rowBefore(IndexPath indexPath) const;
    void showFocusedRow();
    double sectionTop(int section) const;
    double gapAbove(const Section& section) const;
    double viewHeight() const { return frame().height; }
    double lowestContentOffset() const;

    Style style_;
    TableViewDataSource* dataSource_ = nullptr;
    TableViewDelegate* delegate_ = nullptr;
    std::vector<Section> sections_;
    bool loaded_ = false;
    int depth_ = 0;
    TableChanges pending_;
    int repairs_ = 0;
    std::map<std::string, CellFactory> factories_;
    std::vector<std::shared_ptr<TableViewCell>> freeCells_;
    bool allowsSelection_ = true;
    std::optional<IndexPath> selected_;
    std::optional<IndexPath> focused_;
    EdgeInsets contentInset_;
    std::optional<double> backgroundInset_;
    double contentOffset_ = 0;
};

}  // namespace wp::ui
