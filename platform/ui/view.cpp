#include "platform/ui/view.h"

#include <algorithm>

#include "platform/ui/layout_solver.h"
#include "platform/ui/screen.h"

namespace wp::ui {

View::~View() {
    for (const auto& view : subviews_) view->superview_ = nullptr;
}

void View::addSubview(std::shared_ptr<View> view) {
    view->removeFromSuperview();
    view->superview_ = this;
    subviews_.push_back(std::move(view));
    setNeedsLayout();
    changed();
}

void View::removeFromSuperview() {
    if (!superview_) return;
    View* parent = superview_;
    for (View* above = parent; above; above = above->superview_) above->dropConstraintsWith(*this);
    auto own = std::find_if(parent->subviews_.begin(), parent->subviews_.end(),
                            [this](const auto& view) { return view.get() == this; });
    std::shared_ptr<View> self = *own;
    parent->subviews_.erase(own);
    superview_ = nullptr;
    parent->setNeedsLayout();
    parent->changed();
}

void View::dropConstraintsWith(const View& removed) {
    std::erase_if(constraints_, [&](const LayoutConstraint& constraint) {
        return removed.contains(*constraint.first.view) ||
               (constraint.second.view && removed.contains(*constraint.second.view));
    });
}

View& View::root() {
    View* view = this;
    while (view->superview_) view = view->superview_;
    return *view;
}

bool View::contains(const View& view) const {
    for (const View* above = &view; above; above = above->superview_)
        if (above == this) return true;
    return false;
}

View* View::viewWithIdentifier(std::string_view identifier) {
    if (identifier_ == identifier) return this;
    for (const auto& view : subviews_)
        if (View* found = view->viewWithIdentifier(identifier)) return found;
    return nullptr;
}

Screen* View::screen() const {
    const View* view = this;
    while (view->superview_) view = view->superview_;
    return view->screen_;
}

void View::setScreen(Screen* screen) {
    screen_ = screen;
    setNeedsLayout();
}

void View::setFrame(Rect frame) {
    if (frame_ == frame) return;
    double widening = frame.width - frame_.width;
    frame_ = frame;
    for (const auto& view : subviews_) {
        if (view->laidOutByConstraints_ || !(view->autoresizingMask_ & kFlexibleWidth)) continue;
        Rect own = view->frame_;
        view->setFrame({own.x, own.y, own.width + widening, own.height});
    }
    setNeedsLayout();
    changed();
}

Rect View::frameOnScreen() const {
    Rect rect = frame_;
    for (const View* above = superview_; above; above = above->superview_) {
        rect.x += above->frame_.x;
        rect.y += above->frame_.y;
    }
    return rect;
}

void View::addConstraint(const LayoutConstraint& constraint) {
    constraints_.push_back(constraint);
    setNeedsLayout();
}

void View::setContentHuggingPriority(Axis axis, Priority priority) {
    setContent(hugging_[index(axis)], priority);
}

void View::setCompressionResistancePriority(Axis axis, Priority priority) {
    setContent(resistance_[index(axis)], priority);
}

void View::setNeedsLayout() {
    for (View* view = this; view; view = view->superview_) view->needsLayout_ = true;
}

void View::layoutIfNeeded() {
    View& top = root();
    if (!top.needsLayout_) return;
    LayoutReport report = solveLayout(top);
    top.layoutSubviewsBelow();
    if (top.screen_) top.screen_->takeLayoutReport(std::move(report));
}

void View::layoutSubviewsBelow() {
    needsLayout_ = false;
    layoutSubviews();
    for (std::size_t i = 0; i < subviews_.size(); ++i) subviews_[i]->layoutSubviewsBelow();
    needsLayout_ = false;
}

const TextMeasurer& View::textMeasurer() const {
    Screen* shown = screen();
    return shown ? shown->textMeasurer() : FixedTextMeasurer::shared();
}

void View::changed() {
    if (Screen* shown = screen()) shown->viewChanged();
}

}  // namespace wp::ui
