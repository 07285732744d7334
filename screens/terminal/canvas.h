#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "screens/terminal/cells.h"

namespace wp::terminal {

/// What a cell is, for the colours; without colours only the attributes tell.
enum class Ink { plain, accent, bar };

struct Style {
    Ink ink = Ink::plain;
    bool bold = false;
    bool dim = false;
    bool reverse = false;

    friend bool operator==(const Style&, const Style&) = default;
};

/// A picture of the terminal, cell by cell, drawn whole before any of it is shown. What would lie outside is
/// left out. *Main*.
class Canvas {
  public:
    /// A wide character fills its own square and leaves the one to its right empty.
    struct Square {
        std::wstring text = L" ";
        Style style;

        friend bool operator==(const Square&, const Square&) = default;
    };

    Canvas(int rows, int columns, Charset charset);

    int rows() const { return rows_; }
    int columns() const { return columns_; }
    Charset charset() const { return charset_; }
    const Square& at(int row, int column) const;

    /// Puts the cells beginning at the place, cut (without an ellipsis) at the right edge. Returns the column
    /// after the last.
    int put(int row, int column, const Cells& cells, Style style);

    /// Puts a text of the product's own: the first where the terminal has Unicode, else the second.
    int put(int row, int column, std::string_view unicode, std::string_view ascii, Style style);

    /// Puts blanks.
    void fill(int row, int column, int width, Style style);

    /// Draws what is there as something behind.
    void dim(int row, int column);

    /// Where the cursor stands while text is entered; hidden when there is none.
    struct Cursor {
        int row = -1;
        int column = -1;
        bool isVisible() const { return row >= 0; }
    };
    Cursor cursor;

    /// The picture as lines of UTF-8 without blanks at their ends.
    std::string text() const;

  private:
    Square& square(int row, int column);
    void clear(int row, int column, int width, Style style);

    int rows_;
    int columns_;
    Charset charset_;
    std::vector<Square> squares_;
};

}  // namespace wp::terminal
