#include "platform/ui/label.h"

namespace wp::ui {

TextSize Label::measured(double width) const {
    double limit = numberOfLines_ == 1 ? 0 : width > 0 ? width : preferredMaxLayoutWidth_;
    return textMeasurer().measure(text_, font_, limit, numberOfLines_);
}

Font Label::fittingFont() const {
    Font font = font_;
    if (!adjustsFontSize_ || frame().width <= 0) return font;
    auto fits = [&] {
        TextSize size =
            textMeasurer().measure(text_, font, numberOfLines_ == 1 ? 0 : frame().width, numberOfLines_);
        return size.fits && size.size.width <= frame().width;
    };
    while (font.size > kSmallestSize && !fits()) font.size -= 1;
    return font;
}

Size Label::sizeThatFits() const {
    return textMeasurer().measure(text_, font_, 0, numberOfLines_).size;
}

void Label::sizeToFit() {
    Size size = sizeThatFits();
    setFrame({frame().x, frame().y, size.width, size.height});
}

View::IntrinsicSize Label::intrinsicSize(double width) const {
    Size size = measured(width).size;
    return {size.width, size.height};
}

double Label::lastBaselineOffsetFromBottom(double width) const {
    return measured(width).descent;
}

}  // namespace wp::ui
