#include "platform/ui/table_view_cell.h"

#include <algorithm>

namespace wp::ui {

namespace {
constexpr Font kFont{TextStyle::body, 32};
}  // namespace

double TableViewCell::detailWidth() const {
    if (style_ != Style::value1 || detailText_.empty()) return 0;
    double wanted = textMeasurer().measure(detailText_, kFont, 0, 1).size.width;
    return std::clamp(wanted, 0.0, std::max(0.0, frame().width - 2 * kMargin));
}

Rect TableViewCell::textFrame() const {
    double detail = detailWidth();
    double gap = detail > 0 ? kMargin : 0;
    double width = std::max(0.0, frame().width - 2 * kMargin - detail - gap);
    return {kMargin, 0, width, frame().height};
}

Rect TableViewCell::detailTextFrame() const {
    double detail = detailWidth();
    return {frame().width - kMargin - detail, 0, detail, detail > 0 ? frame().height : 0};
}

double TableViewCell::subtitleHeight(const TextMeasurer& measurer, double width) const {
    // A front end may round its letters up a little.
    constexpr double kSafePart = 0.97;
    double limit = kSafePart * (width - 2 * kSubtitleSideMargin);
    double height = 2 * kSubtitleTopMargin + measurer.measure(text_, kSubtitleTextFont, limit, 0).size.height;
    if (detailText_.empty()) return height;
    return height + kSubtitleGap + measurer.measure(detailText_, kSubtitleDetailFont, limit, 0).size.height;
}

void TableViewCell::prepareForReuse() {
    setText({});
    setDetailText({});
    setSelected(false);
    setUserInteractionEnabled(true);
}

}  // namespace wp::ui
