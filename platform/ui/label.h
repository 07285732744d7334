#pragma once

#include "platform/ui/view.h"

namespace wp::ui {

/// Plain text on one or more lines: never markup, whatever a name may hold. *Main*.
class Label : public View {
  public:
    explicit Label(Rect frame = {}) : View(frame) {}

    const std::string& text() const { return text_; }
    void setText(const std::string& text) { setContent(text_, text); }
    const Font& font() const { return font_; }
    void setFont(const Font& font) { setContent(font_, font); }
    const Color& textColor() const { return textColor_; }
    void setTextColor(Color color) { set(textColor_, color); }
    TextAlignment textAlignment() const { return textAlignment_; }
    void setTextAlignment(TextAlignment alignment) { set(textAlignment_, alignment); }
    LineBreakMode lineBreakMode() const { return lineBreakMode_; }
    void setLineBreakMode(LineBreakMode mode) { set(lineBreakMode_, mode); }
    BaselineAdjustment baselineAdjustment() const { return baselineAdjustment_; }
    void setBaselineAdjustment(BaselineAdjustment adjustment) { set(baselineAdjustment_, adjustment); }
    /// At most so many lines; 0: as many as it takes.
    int numberOfLines() const { return numberOfLines_; }
    void setNumberOfLines(int lines) { setContent(numberOfLines_, lines); }
    /// Whether a text that does not fit is drawn smaller before it is cut.
    bool adjustsFontSizeToFitWidth() const { return adjustsFontSize_; }
    void setAdjustsFontSizeToFitWidth(bool adjusts) { set(adjustsFontSize_, adjusts); }
    /// The width at which the text wraps while the layout knows no other; 0: none.
    double preferredMaxLayoutWidth() const { return preferredMaxLayoutWidth_; }
    void setPreferredMaxLayoutWidth(double width) { setContent(preferredMaxLayoutWidth_, width); }

    /// The font to draw with at the label's width: its own, or where it adjusts and the text does not fit on
    /// its lines, the largest that fits, but none below `kSmallestSize`.
    Font fittingFont() const;
    /// Smaller letters cannot be read from three metres.
    static constexpr double kSmallestSize = 24;

    /// The size of the whole text, wrapped only where its lines break.
    Size sizeThatFits() const;
    /// Takes that size, and keeps its place.
    void sizeToFit();

    IntrinsicSize intrinsicSize(double width) const override;
    double lastBaselineOffsetFromBottom(double width) const override;

  private:
    TextSize measured(double width) const;

    std::string text_;
    Font font_;
    Color textColor_ = Color::black();
    TextAlignment textAlignment_ = TextAlignment::left;
    LineBreakMode lineBreakMode_ = LineBreakMode::byTruncatingTail;
    BaselineAdjustment baselineAdjustment_ = BaselineAdjustment::alignBaselines;
    int numberOfLines_ = 1;
    double preferredMaxLayoutWidth_ = 0;
    bool adjustsFontSize_ = false;
};

}  // namespace wp::ui
