#include "platform/ui/text_measurer.h"

#include <algorithm>
#include <cmath>

#include "platform/ui/unicode.h"

namespace wp::ui {
namespace {

// A line of 29 points is 34 high, 7 of them below the baseline; other sizes in proportion.
constexpr double kLineOfBody = 34.0 / 29.0;
constexpr double kDescentOfBody = 7.0 / 29.0;

/// Fills lines word by word; a word wider than a line is cut where the line ends.
class Wrapper {
  public:
    Wrapper(double width, double unit) : width_(width > 0 ? width : HUGE_VAL), unit_(unit) {}

    void add(char32_t value) {
        double advance = cellWidth(value) * unit_;
        if (value == '\n') {
            breakLine(0);
        } else if (value == ' ') {
            line_ += advance;
            wordStart_ = line_;
        } else {
            if (line_ + advance > width_) breakLine(wordStart_ > 0 ? wordStart_ : line_);
            line_ += advance;
            widest_ = std::max(widest_, line_);
        }
    }

    int lines() const { return lines_; }
    double widest() const { return widest_; }

  private:
    // Text from the position on moves to the next line; 0 moves nothing.
    void breakLine(double from) {
        line_ = from > 0 ? line_ - from : 0;
        wordStart_ = 0;
        ++lines_;
    }

    double width_;
    double unit_;
    double line_ = 0;
    double wordStart_ = 0;
    double widest_ = 0;
    int lines_ = 1;
};

}  // namespace

TextSize FixedTextMeasurer::measure(std::string_view text, const Font& font, double width,
                                    int maxLines) const {
    double lineHeight = std::ceil(font.size * kLineOfBody);
    TextSize result;
    result.descent = std::round(font.size * kDescentOfBody);
    if (text.empty()) return {{0, 0}, 0, 0, true};
    Wrapper wrapper(width, font.size / 2);
    for (std::size_t position = 0; position < text.size();) {
        CodePoint point = codePointAt(text, position);
        wrapper.add(point.value);
        position += point.length;
    }
    result.lines = maxLines > 0 ? std::min(wrapper.lines(), maxLines) : wrapper.lines();
    result.fits = result.lines == wrapper.lines();
    double widest = width > 0 ? std::min(wrapper.widest(), width) : wrapper.widest();
    result.size = {std::ceil(widest), lineHeight * result.lines};
    return result;
}

const FixedTextMeasurer& FixedTextMeasurer::shared() {
    static const FixedTextMeasurer measurer;
    return measurer;
}

}  // namespace wp::ui
