#pragma once

#include <string_view>

#include "platform/ui/geometry.h"
#include "platform/ui/style.h"

namespace wp::ui {

/// What a text takes up.
struct TextSize {
    Size size;           ///< of all lines together, points
    double descent = 0;  ///< from the last line's baseline down to the lower edge
    int lines = 0;       ///< after wrapping, at most the limit
    bool fits = true;    ///< false when the limit cut something off
};

/// How a front end tells the layout what its fonts take up. *Main*.
class TextMeasurer {
  public:
    virtual ~TextMeasurer() = default;

    /// Measures the text wrapped at words to the width (0: no limit) on at most so many lines (0: no limit).
    virtual TextSize measure(std::string_view text, const Font& font, double width, int maxLines) const = 0;
};

/// Measures by a fixed table: half the font size for a narrow character, the whole for a wide one, nothing
/// for a combining one; a line is 34/29 of the size high, rounded up, with a fifth of it below the baseline.
/// Layouts come out the same on every machine.
class FixedTextMeasurer final : public TextMeasurer {
  public:
    TextSize measure(std::string_view text, const Font& font, double width, int maxLines) const override;

    static const FixedTextMeasurer& shared();
};

}  // namespace wp::ui
