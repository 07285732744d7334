#pragma once

#include <optional>
#include <vector>

#include "platform/ui/index_path.h"
#include "platform/ui/table_view.h"
#include "screens/terminal/canvas.h"

namespace wp::terminal {

/// One line of the list as the terminal shows it, from top to bottom.
struct ListLine {
    enum class Kind { blank, header, row };

    Kind kind = Kind::blank;
    /// The row; of a header only the section counts.
    ui::IndexPath path;
    /// Which of the row's own lines.
    int part = 0;
};

/// The table's lines: each section's title (with a blank line before it, but at the top) and its rows. A row takes
/// one line, or as many as its texts take at that width.
std::vector<ListLine> linesOf(const ui::SettingsTableView& table, int columns, Charset charset);

/// The first line to show in a window of that height, so that the focused row is inside, and the title above
/// it where it is its section's first row. Moves as little as it takes from where it was.
int firstLineToShow(const std::vector<ListLine>& lines, std::optional<ui::IndexPath> focused, int height,
                    int before);

/// The part of the terminal that a picture may fill.
struct Area {
    int row = 0;
    int column = 0;
    int rows = 0;
    int columns = 0;
};

/// Draws the table in a frame. The focus is seen by its mark and by reversed colours; while selection is off
/// by a hollow mark alone. Updates the first line shown.
void drawList(Canvas& canvas, Area area, const ui::SettingsTableView& table,
              std::optional<ui::IndexPath> focused, int& firstLine);

/// A frame of lines around the area's edge.
void drawFrame(Canvas& canvas, Area area, Style style);

}  // namespace wp::terminal
