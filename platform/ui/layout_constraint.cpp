#include "platform/ui/layout_constraint.h"

#include <sstream>

#include "platform/ui/view.h"

namespace wp::ui {
namespace {

const char* name(Attribute attribute) {
    switch (attribute) {
        case Attribute::none:
            return "";
        case Attribute::top:
            return "top";
        case Attribute::bottom:
            return "bottom";
        case Attribute::leading:
            return "leading";
        case Attribute::trailing:
            return "trailing";
        case Attribute::width:
            return "width";
        case Attribute::height:
            return "height";
        case Attribute::centerX:
            return "centerX";
        case Attribute::centerY:
            return "centerY";
        case Attribute::lastBaseline:
            return "lastBaseline";
    }
    return "";
}

std::string text(const Anchor& anchor) {
    const std::string& identifier = anchor.view->identifier();
    return (identifier.empty() ? "view" : identifier) + "." + name(anchor.attribute);
}

View* commonAncestor(const LayoutConstraint& constraint) {
    View* ancestor = constraint.first.view;
    const View* other = constraint.second.view ? constraint.second.view : ancestor;
    while (ancestor && !ancestor->contains(*other)) ancestor = ancestor->superview();
    return ancestor;
}

}  // namespace

std::string LayoutConstraint::text() const {
    std::ostringstream out;
    out << ui::text(first) << (relation == Relation::equal ? " = " : " >= ");
    if (second.view) {
        out << ui::text(second);
        if (constant != 0) out << (constant < 0 ? " - " : " + ") << (constant < 0 ? -constant : constant);
    } else {
        out << constant;
    }
    return out.str();
}

std::vector<LayoutConstraint> activateConstraints(const std::vector<LayoutConstraint>& constraints) {
    std::vector<LayoutConstraint> rejected;
    for (const LayoutConstraint& constraint : constraints) {
        if (View* ancestor = commonAncestor(constraint)) {
            ancestor->addConstraint(constraint);
        } else {
            rejected.push_back(constraint);
        }
    }
    return rejected;
}

}  // namespace wp::ui
