#pragma once

#include <string>
#include <vector>

namespace wp::ui {

class View;

/// What a layout could not satisfy or had to settle by itself.
struct LayoutReport {
    std::vector<std::string> conflicts;  ///< required constraints that cannot hold; the others were kept
    std::vector<std::string> ambiguous;  ///< "description.y": nothing but the last pull decides it
};

/// Gives every view of the tree that is laid out by constraints its frame; the others and the root keep
/// theirs, and a flexible width follows the superview's. Equalities hold by priority, then by the order in
/// which they were activated; of the inequalities exactly those become equalities that would be violated.
/// What nothing but an inequality bounds stands at that bound. The content's own sizes enter at the views'
/// hugging and resistance priorities. *Main*.
LayoutReport solveLayout(View& root);

}  // namespace wp::ui
