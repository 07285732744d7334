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

void TableViewCell::prepareForReuse() {
    setText({});
    setDetailText({});
    setSelected(false);
    setUserInteractionEnabled(true);
}

}  // namespace wp::ui
