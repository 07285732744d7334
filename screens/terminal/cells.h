#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace wp::terminal {

/// Which characters the terminal can be sent.
enum class Charset { ascii, unicode };

/// One grapheme where the terminal shows it: a base character with its combining marks. Holds nothing but
/// what may be sent to the terminal.
struct Cell {
    std::wstring text;
    /// 1, or 2 for a wide character.
    int columns = 1;
};

using Cells = std::vector<Cell>;

/// The cells of a text's display form. What the terminal cannot show (by its character set, or because the
/// system's tables know no width for it) becomes a visible escape; a combining mark without a base stands on
/// a dotted circle. Widths are those of `wcwidth`, which the drawing library uses too, so LC_CTYPE must be
/// that of the terminal. *Main*.
Cells cellsOf(std::string_view text, Charset charset);

int columnsOf(const Cells& cells);

/// The cells cut to the columns, with an ellipsis at the end where something is left out.
Cells elided(Cells cells, int columns, Charset charset);

/// Lines of at most the given columns, broken at blanks and beside wide characters, a too long word anywhere.
/// What does not fit into the lines is left out, with an ellipsis at the end of the last.
std::vector<Cells> wrapped(const Cells& cells, int columns, int maxLines, Charset charset);

}  // namespace wp::terminal
