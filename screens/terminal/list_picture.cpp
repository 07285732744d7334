#include "screens/terminal/list_picture.h"

#include <algorithm>

namespace wp::terminal {
namespace {

bool hasTitle(const ui::SettingsTableView& table, int section) {
    const auto& title = table.titleForHeader(section);
    return title && !title->empty();
}

/// A long text is told in this many lines, or cut off.
constexpr int kMostLines = 12;
constexpr int kDetailIndent = 2;
/// For the focus' mark on the left and air on the right.
constexpr int kRowMargins = 3;

bool isBlock(const ui::TableViewCell& cell) {
    return cell.style() == ui::TableViewCell::Style::subtitle;
}

/// The lines of a row: its text, or text and detail over as many as they take.
std::vector<Cells> textOf(const ui::TableViewCell& cell, int columns, Charset charset) {
    if (!isBlock(cell)) return {elided(cellsOf(cell.text(), charset), columns, charset)};
    std::vector<Cells> lines = wrapped(cellsOf(cell.text(), charset), columns, kMostLines, charset);
    Cells detail = cellsOf(cell.detailText(), charset);
    for (Cells& line : wrapped(detail, columns - kDetailIndent, kMostLines, charset)) {
        line.insert(line.begin(), kDetailIndent, Cell{L" ", 1});
        lines.push_back(std::move(line));
    }
    return lines;
}

int lineOf(const std::vector<ListLine>& lines, ui::IndexPath path) {
    auto isLine = [&](const ListLine& line) { return line.kind == ListLine::Kind::row && line.path == path; };
    return static_cast<int>(std::find_if(lines.begin(), lines.end(), isLine) - lines.begin());
}

const ListLine& lineAt(const std::vector<ListLine>& lines, int index) {
    return lines[static_cast<std::size_t>(index)];
}

/// Draws the lines that fall into the window.
class ListPainter {
  public:
    ListPainter(Canvas& canvas, Area area, const ui::SettingsTableView& table,
                std::optional<ui::IndexPath> focused)
        : canvas_(canvas), area_(area), table_(table), focused_(focused), isDim_(table.alpha() < 1) {}

    void drawLine(int row, const ListLine& line) {
        if (line.kind == ListLine::Kind::header) drawHeader(row, *table_.titleForHeader(line.path.section));
        if (line.kind == ListLine::Kind::row) drawRow(row, line);
    }

  private:
    void drawHeader(int row, const std::string& title) {
        Style style{.ink = Ink::accent, .bold = !isDim_, .dim = isDim_};
        canvas_.put(row, area_.column,
                    elided(cellsOf(title, canvas_.charset()), area_.columns, canvas_.charset()), style);
    }

    void drawRow(int row, const ListLine& line) {
        const ui::TableViewCell& cell = *table_.cellForRow(line.path);
        bool isFocused = focused_ == line.path;
        bool isLive = isFocused && table_.allowsSelection();
        Style style{.bold = isLive, .dim = isDim_ || !cell.isUserInteractionEnabled(), .reverse = isLive};
        if (isLive) canvas_.fill(row, area_.column, area_.columns, style);
        if (isFocused && line.part == 0) {
            if (isLive)
                canvas_.put(row, area_.column, "\u25B8", ">", style);
            else
                canvas_.put(row, area_.column, "\u25B9", "-", style);
        }
        std::vector<Cells> text = textOf(cell, area_.columns - kRowMargins, canvas_.charset());
        canvas_.put(row, area_.column + 2, text[static_cast<std::size_t>(line.part)], style);
    }

    Canvas& canvas_;
    Area area_;
    const ui::SettingsTableView& table_;
    std::optional<ui::IndexPath> focused_;
    bool isDim_;
};

/// Shows in the frame's right line which part of the list the window is.
void drawScrollMark(Canvas& canvas, Area frame, int first, int height, int count) {
    if (count <= height) return;
    int length = std::max(1, height * height / count);
    int top = (height - length) * first / (count - height);
    for (int row = 0; row < length; ++row)
        canvas.put(frame.row + 1 + top + row, frame.column + frame.columns - 1, "\u2588", "#", {});
}

}  // namespace

std::vector<ListLine> linesOf(const ui::SettingsTableView& table, int columns, Charset charset) {
    std::vector<ListLine> lines;
    for (int section = 0; section < table.numberOfSections(); ++section) {
        if (hasTitle(table, section)) {
            if (!lines.empty()) lines.push_back({ListLine::Kind::blank, {}});
            lines.push_back({ListLine::Kind::header, {0, section}});
        }
        for (int row = 0; row < table.numberOfRows(section); ++row) {
            const ui::TableViewCell& cell = *table.cellForRow({row, section});
            int parts =
                isBlock(cell) ? static_cast<int>(textOf(cell, columns - kRowMargins, charset).size()) : 1;
            for (int part = 0; part < parts; ++part)
                lines.push_back({ListLine::Kind::row, {row, section}, part});
        }
    }
    return lines;
}

int firstLineToShow(const std::vector<ListLine>& lines, std::optional<ui::IndexPath> focused, int height,
                    int before) {
    int count = static_cast<int>(lines.size());
    int first = before;
    int at = focused ? lineOf(lines, *focused) : count;
    if (at < count) {
        bool isUnderTitle = at > 0 && lineAt(lines, at - 1).kind == ListLine::Kind::header;
        int last = at;
        auto isOfRow = [&](const ListLine& line) { return line.path == *focused && line.part > 0; };
        while (last + 1 < count && isOfRow(lineAt(lines, last + 1))) ++last;
        first = std::max(first, last - height + 1);
        first = std::min(first, isUnderTitle && height > 1 ? at - 1 : at);
    }
    return std::clamp(first, 0, std::max(0, count - height));
}

void drawList(Canvas& canvas, Area area, const ui::SettingsTableView& table,
              std::optional<ui::IndexPath> focused, int& firstLine) {
    Style frame{.dim = true};
    drawFrame(canvas, area, frame);
    Area inner{area.row + 1, area.column + 2, area.rows - 2, area.columns - 4};
    std::vector<ListLine> lines = linesOf(table, inner.columns, canvas.charset());
    firstLine = firstLineToShow(lines, table.lastFocusedIndexPath(), inner.rows, firstLine);
    ListPainter painter(canvas, inner, table, focused);
    int count = static_cast<int>(lines.size());
    for (int row = 0; row < inner.rows && firstLine + row < count; ++row)
        painter.drawLine(inner.row + row, lineAt(lines, firstLine + row));
    drawScrollMark(canvas, area, firstLine, inner.rows, count);
}

void drawFrame(Canvas& canvas, Area area, Style style) {
    int right = area.column + area.columns - 1;
    int bottom = area.row + area.rows - 1;
    for (int column = area.column + 1; column < right; ++column) {
        canvas.put(area.row, column, "\u2500", "-", style);
        canvas.put(bottom, column, "\u2500", "-", style);
    }
    for (int row = area.row + 1; row < bottom; ++row) {
        canvas.put(row, area.column, "\u2502", "|", style);
        canvas.put(row, right, "\u2502", "|", style);
    }
    canvas.put(area.row, area.column, "\u250C", "+", style);
    canvas.put(area.row, right, "\u2510", "+", style);
    canvas.put(bottom, area.column, "\u2514", "+", style);
    canvas.put(bottom, right, "\u2518", "+", style);
}

}  // namespace wp::terminal
