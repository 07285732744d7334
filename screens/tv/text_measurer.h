#pragma once

#include <QFont>

#include "platform/ui/text_measurer.h"

namespace wp::tv {

/// The face of the screen, which the module brings with it. Other scripts come from what is installed.
inline constexpr const char* kFontFamily = "DejaVu Sans";

/// Makes the face known. Once, after the application is made. *Main*.
void loadFonts();

/// The font as it is drawn: without hinting, so that a text takes the same points on a screen of any size.
QFont fontOf(const ui::Font& font);

/// Measures by the metrics of the fonts that are drawn with. *Main*.
class TextMeasurer final : public ui::TextMeasurer {
  public:
    ui::TextSize measure(std::string_view text, const ui::Font& font, double width,
                         int maxLines) const override;
};

/// The narrowest width, in points, at which the text takes no more lines than at the given one and no word of it is
/// broken: its lines come out about as long as each other, and none is left with a word alone.
double balancedWidth(const ui::TextMeasurer& measurer, const QString& text, const ui::Font& font,
                     double width);

/// Where the cursor stands in a line of text, in points from its left edge. The position is in UTF-16 units.
double cursorPosition(const QString& text, int position, const ui::Font& font);

}  // namespace wp::tv
