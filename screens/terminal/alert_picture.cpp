#include "screens/terminal/alert_picture.h"

#include <algorithm>
#include <optional>

#include "screens/terminal/list_picture.h"

namespace wp::terminal {
namespace {

constexpr int kWidestBox = 64;
constexpr int kMostMessageLines = 5;
// A line and two blanks on either side; above and below a line and, where there is room, a blank one.
constexpr int kSides = 6;

/// An action as it is drawn: the mark's place and its title, in brackets while it can be chosen.
Cells labelOf(const ui::AlertAction& action, int columns, Charset charset) {
    Cells title = elided(cellsOf(action.title(), charset), columns - 6, charset);
    Cells label = cellsOf(action.isEnabled() ? "[ " : "  ", charset);
    label.insert(label.end(), title.begin(), title.end());
    Cells close = cellsOf(action.isEnabled() ? " ]" : "  ", charset);
    label.insert(label.end(), close.begin(), close.end());
    return label;
}

class AlertPainter {
  public:
    AlertPainter(Canvas& canvas, const ui::AlertController& alert)
        : canvas_(canvas), alert_(alert), charset_(canvas.charset()) {
        inner_.columns = std::min(canvas.columns() - 10, kWidestBox) - kSides;
        title_ = linesOf(alert.title(), 2);
        message_ = linesOf(alert.message(), kMostMessageLines);
        for (const auto& action : alert.actions())
            labels_.push_back(labelOf(*action, inner_.columns, charset_));
        isInOneLine_ = widthOfActions() <= inner_.columns;
    }

    void draw() {
        placeBox();
        int row = inner_.row;
        row = drawLines(row, title_, {.bold = true});
        row = drawLines(row, message_, {});
        if (!alert_.textFields().empty()) row = drawField(row, *alert_.textFields().front());
        drawActions(row);
    }

  private:
    std::vector<Cells> linesOf(const std::optional<std::string>& text, int maxLines) const {
        if (!text || text->empty()) return {};
        return wrapped(cellsOf(*text, charset_), inner_.columns, maxLines, charset_);
    }

    /// With two columns for the mark before each.
    int widthOfActions() const {
        int width = 0;
        for (const Cells& label : labels_) width += 2 + columnsOf(label);
        return width;
    }

    /// Each block of lines is followed by an empty line.
    int heightOf() const {
        int height = 0;
        for (const auto* lines : {&title_, &message_})
            if (!lines->empty()) height += static_cast<int>(lines->size()) + 1;
        if (!alert_.textFields().empty()) height += 2;
        return height + (isInOneLine_ ? 1 : static_cast<int>(labels_.size()));
    }

    void placeBox() {
        inner_.rows = heightOf();
        int padding = inner_.rows + 4 <= canvas_.rows() ? 1 : 0;
        Area box{0, 0, inner_.rows + 2 + 2 * padding, inner_.columns + kSides};
        box.row = std::max(0, (canvas_.rows() - box.rows) / 2);
        box.column = (canvas_.columns() - box.columns) / 2;
        // With a blank column on either side, so that no name behind runs into the frame.
        for (int row = box.row; row < box.row + box.rows; ++row)
            canvas_.fill(row, box.column - 1, box.columns + 2, {});
        drawFrame(canvas_, box, {.ink = Ink::accent, .bold = true});
        inner_.row = box.row + 1 + padding;
        inner_.column = box.column + 3;
    }

    int drawLines(int row, const std::vector<Cells>& lines, Style style) {
        for (const Cells& line : lines) canvas_.put(row++, inner_.column, line, style);
        return lines.empty() ? row : row + 1;
    }

    int drawField(int row, const ui::TextField& field) {
        canvas_.put(row, inner_.column, "\u203A", ">", {.ink = Ink::accent, .bold = true});
        int width = inner_.columns - 2;
        Cells before = cellsOf(std::string_view(field.text()).substr(0, field.cursor()), charset_);
        Cells all = cellsOf(field.text(), charset_);
        int cursor = columnsOf(before);
        // A text longer than the field is shown from where the cursor is inside it.
        std::size_t first = 0;
        for (int hidden = cursor - (width - 1); hidden > 0 && first < all.size(); ++first)
            hidden -= all[first].columns, cursor -= all[first].columns;
        Cells shown(all.begin() + static_cast<std::ptrdiff_t>(first), all.end());
        while (columnsOf(shown) > width) shown.pop_back();
        if (field.text().empty())
            canvas_.put(row, inner_.column + 2,
                        elided(cellsOf(field.placeholder(), charset_), width, charset_), {.dim = true});
        else
            canvas_.put(row, inner_.column + 2, shown, {});
        if (alert_.focus().on == ui::AlertController::Focus::On::field)
            canvas_.cursor = {row, inner_.column + 2 + cursor};
        return row + 2;
    }

    void drawActions(int row) {
        int column = inner_.column + (isInOneLine_ ? inner_.columns - widthOfActions() : 0);
        for (std::size_t index = 0; index < labels_.size(); ++index) {
            drawAction(row, column, index);
            if (isInOneLine_)
                column += 2 + columnsOf(labels_[index]);
            else
                ++row;
        }
    }

    void drawAction(int row, int column, std::size_t index) {
        using On = ui::AlertController::Focus::On;
        bool isFocused = alert_.focus() == ui::AlertController::Focus{On::action, index};
        bool isEnabled = alert_.actions()[index]->isEnabled();
        if (isFocused)
            canvas_.put(row, column + 1, isEnabled ? "\u25B8" : "\u25B9", isEnabled ? ">" : "-", {});
        canvas_.put(row, column + 2, labels_[index],
                    {.bold = isFocused && isEnabled, .dim = !isEnabled, .reverse = isFocused});
    }

    Canvas& canvas_;
    const ui::AlertController& alert_;
    Charset charset_;
    Area inner_;
    std::vector<Cells> title_;
    std::vector<Cells> message_;
    std::vector<Cells> labels_;
    bool isInOneLine_ = true;
};

}  // namespace

void drawAlert(Canvas& canvas, const ui::AlertController& alert) {
    AlertPainter(canvas, alert).draw();
}

}  // namespace wp::terminal
