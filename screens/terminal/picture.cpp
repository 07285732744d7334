#include "screens/terminal/picture.h"

#include <algorithm>
#include <cmath>

#include "platform/ui/controls.h"
#include "platform/ui/identifiers.h"
#include "platform/ui/label.h"
#include "screens/terminal/alert_picture.h"
#include "screens/terminal/list_picture.h"

namespace wp::terminal {
namespace {

// Longer lines are hard to read, and a list's rows are short.
constexpr int kWidestContent = 88;
constexpr int kMostDescriptionLines = 5;
constexpr int kWidestBar = 48;
// The list keeps at least its frame and this many lines.
constexpr int kFewestListRows = 8;
constexpr int kTitleRows = 2;
constexpr int kHintRows = 1;

/// A text of the product's own, in which lines are broken for another width.
std::string flowing(std::string text) {
    std::replace(text.begin(), text.end(), '\n', ' ');
    return text;
}

class ScreenPainter {
  public:
    ScreenPainter(Canvas& canvas, const ui::Screen& screen, const Texts& texts)
        : canvas_(canvas), screen_(screen), texts_(texts), charset_(canvas.charset()) {
        width_ = std::min(canvas.columns() - 4, kWidestContent);
        left_ = (canvas.columns() - width_) / 2;
    }

    void draw(int& firstLine) {
        drawTitle();
        int row = kTitleRows;
        row = drawAbove(row);
        if (const ui::SettingsTableView* table = screen_.table(); table && !table->isHidden())
            drawList(canvas_, {row, left_, canvas_.rows() - kHintRows - row, width_}, *table,
                     screen_.focusedIndexPath(), firstLine);
        drawHints();
    }

  private:
    const ui::Label* label(const char* identifier) const { return screen_.viewAs<ui::Label>(identifier); }

    Cells line(std::string_view text, int columns) const {
        return elided(cellsOf(text, charset_), columns, charset_);
    }

    void drawTitle() {
        Style style{.bold = true, .reverse = true};
        canvas_.fill(0, 0, canvas_.columns(), style);
        if (const ui::Label* title = label(ui::identifiers::title))
            canvas_.put(0, left_, line(title->text(), width_), style);
    }

    /// Draws description, progress and status; hidden ones keep their place, so that the list stays where it
    /// is. Returns the row after them.
    int drawAbove(int row) {
        const ui::Label* description = label(ui::identifiers::description);
        const auto* progress = screen_.viewAs<ui::ProgressView>(ui::identifiers::progress);
        const ui::Label* status = label(ui::identifiers::status);
        if (!description && !progress && !status) return row;
        int most = std::clamp(canvas_.rows() - kTitleRows - kHintRows - 1 - kFewestListRows, 2,
                              kMostDescriptionLines);
        std::vector<Cells> lines;
        if (description)
            lines = wrapped(cellsOf(flowing(description->text()), charset_), width_, most, charset_);
        int height = std::max(static_cast<int>(lines.size()), 2);
        int at = row;
        if (description && !description->isHidden())
            for (const Cells& text : lines) canvas_.put(at++, left_, text, {});
        if (progress && !progress->isHidden()) drawBar(at++, *progress);
        if (status && !status->isHidden()) canvas_.put(at++, left_, line(status->text(), width_), {});
        return std::max(row + height, at) + 1;
    }

    void drawBar(int row, const ui::ProgressView& progress) {
        int width = std::min(width_ - 12, kWidestBar);
        int done = static_cast<int>(std::floor(progress.progress() * static_cast<float>(width)));
        int column = canvas_.put(row, left_, "[", "[", {});
        for (int i = 0; i < width; ++i) {
            if (i < done)
                column = canvas_.put(row, column, "\u2588", "#", {.ink = Ink::bar});
            else
                column = canvas_.put(row, column, "\u2591", ".", {.dim = true});
        }
        column = canvas_.put(row, column, "]", "]", {});
        canvas_.put(row, column + 1, line(countOf(progress), 10), {.bold = true});
    }

    /// Before the first step it may not be known of how many there are.
    static std::string countOf(const ui::ProgressView& progress) {
        int whole = progress.stepCount();
        if (whole <= 0 && progress.progress() == 0) return "";
        if (whole <= 0) return std::to_string(std::lround(progress.progress() * 100)) + " %";
        long done = std::lround(progress.progress() * static_cast<float>(whole));
        return std::to_string(done) + "/" + std::to_string(whole);
    }

    void drawHints() {
        int row = canvas_.rows() - 1;
        int column = left_;
        column = drawHint(row, column, "\u2191\u2193", "Up/Down", texts_.move);
        column = drawHint(row, column, "Enter", "Enter", texts_.select);
        drawHint(row, column, "Esc", "Esc", texts_.back);
    }

    int drawHint(int row, int column, std::string_view key, std::string_view asciiKey,
                 const std::string& does) {
        column = canvas_.put(row, column, key, asciiKey, {.bold = true});
        return canvas_.put(row, column + 1, cellsOf(does, charset_), {.dim = true}) + 3;
    }

    Canvas& canvas_;
    const ui::Screen& screen_;
    const Texts& texts_;
    Charset charset_;
    int width_ = 0;
    int left_ = 0;
};

void drawTooSmall(Canvas& canvas, const std::string& text) {
    const Charset charset = canvas.charset();
    const auto lines = wrapped(cellsOf(text, charset), canvas.columns(), canvas.rows(), charset);
    int row = (canvas.rows() - static_cast<int>(lines.size())) / 2;
    for (const Cells& line : lines)
        canvas.put(row++, (canvas.columns() - columnsOf(line)) / 2, line, {.bold = true});
}

/// What is behind an alert steps back, and its focus with it.
void dimAll(Canvas& canvas) {
    for (int row = 0; row < canvas.rows(); ++row)
        for (int column = 0; column < canvas.columns(); ++column) canvas.dim(row, column);
}

}  // namespace

Canvas draw(const ui::Screen& screen, int rows, int columns, Charset charset, const Texts& texts,
            int& firstLine) {
    Canvas canvas(rows, columns, charset);
    if (rows < kFewestRows || columns < kFewestColumns) {
        drawTooSmall(canvas, texts.tooSmall);
        return canvas;
    }
    ScreenPainter(canvas, screen, texts).draw(firstLine);
    if (auto alert = screen.alert()) {
        dimAll(canvas);
        drawAlert(canvas, *alert);
    }
    return canvas;
}

int rowsPerPage(int rows) {
    return std::max(1, rows - kTitleRows - kHintRows - kFewestListRows);
}

}  // namespace wp::terminal
