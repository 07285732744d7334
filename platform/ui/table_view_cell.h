#pragma once

#include <string>

#include "platform/ui/style.h"
#include "platform/ui/text_measurer.h"
#include "platform/ui/view.h"

namespace wp::ui {

/// One row of a table: a text, a detail text, and whether it takes touches (`isUserInteractionEnabled`).
/// *Main*.
class TableViewCell : public View {
  public:
    enum class Style {
        standard = 0,  ///< the text alone
        value1 = 1,    ///< the text on the left, the detail on the right
        subtitle = 3,  ///< the detail below the text, both over as many lines as they take
    };

    TableViewCell(Style style, std::string reuseIdentifier)
        : style_(style), reuseIdentifier_(std::move(reuseIdentifier)) {}

    Style style() const { return style_; }
    const std::string& reuseIdentifier() const { return reuseIdentifier_; }
    /// The text itself; a front end draws control and direction characters in it harmlessly.
    const std::string& text() const { return text_; }
    void setText(const std::string& text) { set(text_, text); }
    const std::string& detailText() const { return detailText_; }
    void setDetailText(const std::string& text) { set(detailText_, text); }
    bool isSelected() const { return selected_; }
    void setSelected(bool selected) { set(selected_, selected); }

    /// Where the two texts stand inside the cell; the detail's rectangle is empty in a style without one.
    Rect textFrame() const;
    Rect detailTextFrame() const;
    /// From the cell's edges to its texts.
    static constexpr double kMargin = 20;

    /// How high a cell of the style `subtitle` must be for its texts, at a width.
    double subtitleHeight(const TextMeasurer& measurer, double width) const;
    static constexpr Font kSubtitleTextFont{TextStyle::body, 32};
    static constexpr Font kSubtitleDetailFont{TextStyle::body, 28};
    static constexpr double kSubtitleSideMargin = 40;
    static constexpr double kSubtitleTopMargin = 18;
    static constexpr double kSubtitleGap = 6;

    /// Makes a cell that was used before as good as new.
    virtual void prepareForReuse();

  private:
    double detailWidth() const;

    Style style_;
    std::string reuseIdentifier_;
    std::string text_;
    std::string detailText_;
    bool selected_ = false;
};

}  // namespace wp::ui
