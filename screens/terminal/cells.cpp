#include "screens/terminal/cells.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <cwchar>
#include <numeric>

#include "platform/ui/display_text.h"

namespace wp::terminal {
namespace {

// The drawing library keeps five characters in a cell.
constexpr std::size_t kMostInACell = 5;
constexpr wchar_t kDottedCircle = 0x25CC;

Cell ellipsis(Charset charset) {
    return {charset == Charset::unicode ? L"\u2026" : L"~", 1};
}

/// What stands on a terminal of ASCII alone for the marks that texts are set with; empty: an escape does.
std::string_view plainMark(char32_t c) {
    switch (c) {
        case 0x2013:
            return "-";
        case 0x2018:
        case 0x2019:
            return "'";
        case 0x201C:
        case 0x201D:
        case 0x201E:
            return "\"";
        case 0x2026:
            return "...";
        default:
            return {};
    }
}

class Composer {
  public:
    explicit Composer(Charset charset) : charset_(charset) {}

    void add(char32_t c) {
        if (c == 0xFE0E || c == 0xFE0F) return;  // terminals disagree on what it does to the width
        auto wide = static_cast<wchar_t>(c);
        bool isSendable = c < 0x7F || charset_ == Charset::unicode;
        int width = isSendable ? wcwidth(wide) : -1;
        std::string_view plain = isSendable ? std::string_view() : plainMark(c);
        if (!plain.empty()) {
            addPlain(plain);
        } else if (width > 0) {
            cells_.push_back({{wide}, width});
            takesMarks_ = true;
        } else if (width < 0 || !addMark(wide)) {
            addEscape(c);
        }
    }

    Cells take() { return std::move(cells_); }

  private:
    bool addMark(wchar_t mark) {
        if (!takesMarks_) cells_.push_back({{kDottedCircle}, 1});
        takesMarks_ = true;
        if (cells_.back().text.size() == kMostInACell) return false;
        cells_.back().text += mark;
        return true;
    }

    void addEscape(char32_t c) {
        std::array<char, 16> text{};
        std::snprintf(text.data(), text.size(), "\\u{%04X}", static_cast<unsigned>(c));
        addPlain(text.data());
    }

    void addPlain(std::string_view text) {
        for (char letter : text) cells_.push_back({{static_cast<wchar_t>(letter)}, 1});
        takesMarks_ = false;
    }

    Charset charset_;
    Cells cells_;
    bool takesMarks_ = false;
};

bool isBlank(const Cell& cell) {
    return cell.text == L" " || cell.text == L"\u3000";
}

// Closing marks do not begin a line.
bool isClosing(const Cell& cell) {
    constexpr std::wstring_view kClosing = L"\u3001\u3002\u300D\u300F\uFF09\uFF01\uFF1F\uFF0C\uFF1A\u30FC";
    return kClosing.find(cell.text[0]) != std::wstring_view::npos;
}

bool mayBreakBefore(const Cells& cells, std::size_t at) {
    if (at == 0 || at >= cells.size()) return true;
    if (isBlank(cells[at])) return true;
    if (isBlank(cells[at - 1])) return true;
    return (cells[at].columns == 2 || cells[at - 1].columns == 2) && !isClosing(cells[at]);
}

/// Where the line that begins at the cell ends (the cell after its last).
std::size_t endOfLine(const Cells& cells, std::size_t begin, int columns) {
    std::size_t fits = begin;
    for (int used = 0; fits < cells.size() && used + cells[fits].columns <= columns; ++fits)
        used += cells[fits].columns;
    for (std::size_t end = fits; end > begin; --end)
        if (mayBreakBefore(cells, end)) return end;
    return std::max(fits, begin + 1);
}

void dropBlanksAtEnd(Cells& cells) {
    while (!cells.empty() && isBlank(cells.back())) cells.pop_back();
}

}  // namespace

Cells cellsOf(std::string_view text, Charset charset) {
    std::string form = ui::displayForm(text);
    Composer composer(charset);
    for (std::string_view rest = form; !rest.empty();) composer.add(*ui::takeCharacter(rest).value);
    return composer.take();
}

int columnsOf(const Cells& cells) {
    return std::accumulate(cells.begin(), cells.end(), 0,
                           [](int sum, const Cell& cell) { return sum + cell.columns; });
}

Cells elided(Cells cells, int columns, Charset charset) {
    if (columnsOf(cells) <= columns) return cells;
    if (columns <= 0) return {};
    while (!cells.empty() && columnsOf(cells) > columns - 1) cells.pop_back();
    cells.push_back(ellipsis(charset));
    return cells;
}

std::vector<Cells> wrapped(const Cells& cells, int columns, int maxLines, Charset charset) {
    std::vector<Cells> lines;
    if (columns <= 0 || maxLines <= 0) return lines;
    std::size_t begin = 0;
    while (begin < cells.size()) {
        bool isLast = static_cast<int>(lines.size()) + 1 == maxLines;
        std::size_t end = isLast ? cells.size() : endOfLine(cells, begin, columns);
        Cells line(cells.begin() + static_cast<std::ptrdiff_t>(begin),
                   cells.begin() + static_cast<std::ptrdiff_t>(end));
        dropBlanksAtEnd(line);
        lines.push_back(elided(std::move(line), columns, charset));
        begin = end;
        while (begin < cells.size() && isBlank(cells[begin])) ++begin;
    }
    return lines;
}

}  // namespace wp::terminal
