#include "screens/terminal/canvas.h"

#include <algorithm>

#include "platform/ui/display_text.h"

namespace wp::terminal {

Canvas::Canvas(int rows, int columns, Charset charset)
    : rows_(std::max(rows, 0)), columns_(std::max(columns, 0)), charset_(charset) {
    squares_.resize(static_cast<std::size_t>(rows_) * static_cast<std::size_t>(columns_));
}

Canvas::Square& Canvas::square(int row, int column) {
    return squares_[static_cast<std::size_t>(row) * static_cast<std::size_t>(columns_) +
                    static_cast<std::size_t>(column)];
}

const Canvas::Square& Canvas::at(int row, int column) const {
    return const_cast<Canvas*>(this)->square(row, column);
}

int Canvas::put(int row, int column, const Cells& cells, Style style) {
    if (row < 0 || row >= rows_ || column < 0) return column;
    for (const Cell& cell : cells) {
        if (column + cell.columns > columns_) break;
        clear(row, column, cell.columns, style);
        square(row, column).text = cell.text;
        if (cell.columns == 2) square(row, column + 1).text = L"";
        column += cell.columns;
    }
    return column;
}

int Canvas::put(int row, int column, std::string_view unicode, std::string_view ascii, Style style) {
    return put(row, column, cellsOf(charset_ == Charset::unicode ? unicode : ascii, charset_), style);
}

void Canvas::fill(int row, int column, int width, Style style) {
    if (row < 0 || row >= rows_) return;
    int begin = std::max(column, 0);
    int end = std::min(column + width, columns_);
    if (begin < end) clear(row, begin, end - begin, style);
}

/// A wide character that is overwritten by half goes as a whole.
void Canvas::clear(int row, int column, int width, Style style) {
    int end = column + width;
    if (square(row, column).text.empty()) square(row, column - 1).text = L" ";
    if (end < columns_ && square(row, end).text.empty()) square(row, end).text = L" ";
    for (int at = column; at < end; ++at) square(row, at) = {L" ", style};
}

void Canvas::dim(int row, int column) {
    Style& style = square(row, column).style;
    style.bold = false;
    style.dim = true;
}

std::string Canvas::text() const {
    std::string picture;
    for (int row = 0; row < rows_; ++row) {
        std::string line;
        for (int column = 0; column < columns_; ++column)
            for (wchar_t c : at(row, column).text) line += ui::encodeUtf8(static_cast<char32_t>(c));
        line.erase(line.find_last_not_of(' ') + 1);
        picture += line + "\n";
    }
    return picture;
}

}  // namespace wp::terminal
