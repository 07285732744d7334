#pragma once

#include <string>
#include <vector>

#include "platform/ui/table_view.h"

namespace wp::tv {

/// One line of a table whose sections stand one below the other: a section's title or a row.
struct Line {
    static constexpr int kHeader = -1;

    int section = 0;
    int row = kHeader;
    std::string text;  ///< in its display form
    std::string detail;
    bool isBlock = false;  ///< text and detail over several lines
    bool isEnabled = true;
    bool isFirst = false;  ///< of its section's rows
    bool isLast = false;
    double top = 0;  ///< points from the content's upper edge
    double height = 0;

    bool isHeader() const { return row == kHeader; }
    friend bool operator==(const Line&, const Line&) = default;
};

/// How a list of lines becomes the next one: removals first, then insertions.
struct LineChanges {
    std::vector<int> removals;    ///< old positions, descending
    std::vector<int> insertions;  ///< new positions, ascending

    bool isEmpty() const { return removals.empty() && insertions.empty(); }
    friend bool operator==(const LineChanges&, const LineChanges&) = default;
};

/// A table's sections flattened into one list of lines. A title stands there only while it takes up room.
/// *Main*.
class FlatTable {
  public:
    const std::vector<Line>& lines() const { return lines_; }

    /// Follows one outermost batch. Rows that stay or are reloaded are the lines that they were.
    LineChanges apply(const ui::SettingsTableView& table, const ui::TableChanges& changes);
    /// Follows a whole reload: a row with the same text in the same section, in the same order, stays.
    LineChanges reload(const ui::SettingsTableView& table);
    LineChanges clear();
    /// Takes texts, places and enabled states anew; no line comes or goes.
    void refresh(const ui::SettingsTableView& table);

  private:
    std::vector<Line> lines_;
};

}  // namespace wp::tv
