#pragma once

#include <string>
#include <vector>

#include "platform/ui/geometry.h"

namespace wp::ui {

class View;

enum class Axis { horizontal, vertical };

enum class Attribute {
    none,  ///< no second view: the constant alone
    top,
    bottom,
    leading,
    trailing,
    width,
    height,
    centerX,
    centerY,
    lastBaseline,  ///< of the last line of text; the lower edge of a view without text
};

/// 1 to 1000; only `required` must hold.
using Priority = int;
namespace priority {
inline constexpr Priority required = 1000;
inline constexpr Priority high = 750;  ///< resistance against being made smaller than the content
inline constexpr Priority low = 250;   ///< pull towards the size of the content
/// The weakest pull, which settles what the constraints leave open.
inline constexpr Priority settle = 1;
}  // namespace priority

/// One attribute of one view: a term of a constraint.
struct Anchor {
    View* view = nullptr;
    Attribute attribute = Attribute::none;
};

enum class Relation { equal, greaterOrEqual };

/// first (= or >=) second + constant.
struct LayoutConstraint {
    Anchor first;
    Relation relation = Relation::equal;
    Anchor second;
    double constant = 0;
    Priority priority = priority::required;

    /// "progress.top = description.lastBaseline + 26", by the views' identifiers.
    std::string text() const;
};

/// Gives each constraint to the nearest view that contains both of its views; they hold from the next layout
/// on. Returns those that no view contains: they have no effect. *Main*.
std::vector<LayoutConstraint> activateConstraints(const std::vector<LayoutConstraint>& constraints);

}  // namespace wp::ui
