#include "platform/ui/screen.h"

#include <algorithm>

#include "platform/ui/identifiers.h"

namespace wp::ui {

Screen::Screen(std::function<void(std::string_view)> note, Size size) : note_(std::move(note)), size_(size) {}

Screen::~Screen() {
    observer_ = nullptr;
    setRootViewController(nullptr);
}

void Screen::setRootViewController(std::shared_ptr<ViewController> controller) {
    while (!alerts_.empty()) dismissAlert(*alerts_.back());
    if (controller_) controller_->attach(nullptr);
    firstResponder_ = nullptr;
    keyPressed_ = false;
    controller_ = std::move(controller);
    if (controller_) controller_->attach(this);
    viewChanged();
}

void Screen::setTextMeasurer(const TextMeasurer* measurer) {
    measurer_ = measurer;
    if (controller_) controller_->view()->setNeedsLayout();
}

const TextMeasurer& Screen::textMeasurer() const {
    return measurer_ ? *measurer_ : FixedTextMeasurer::shared();
}

void Screen::setSize(Size size) {
    size_ = size;
    if (controller_) controller_->view()->setNeedsLayout();
    viewChanged();
}

void Screen::layoutIfNeeded() {
    if (!controller_) return;
    const auto view = controller_->view();
    view->setFrame({0, 0, size_.width, size_.height});
    if (view->needsUpdateConstraints()) controller_->updateViewConstraints();
    view->layoutIfNeeded();
}

void Screen::takeLayoutReport(LayoutReport report) {
    for (const std::string& conflict : report.conflicts) {
        const auto& known = layoutReport_.conflicts;
        if (std::find(known.begin(), known.end(), conflict) == known.end())
            note("layout: cannot hold " + conflict);
    }
    layoutReport_ = std::move(report);
}

View* Screen::view(std::string_view identifier) const {
    return controller_ ? controller_->view()->viewWithIdentifier(identifier) : nullptr;
}

SettingsTableView* Screen::table() const {
    return viewAs<SettingsTableView>(identifiers::table);
}

std::string Screen::screenName() const {
    bool hasViews = controller_ && !controller_->view()->subviews().empty();
    return hasViews ? controller_->screenName() : "none";
}

std::optional<IndexPath> Screen::focusedIndexPath() const {
    SettingsTableView* shown = table();
    return shown && alerts_.empty() ? shown->lastFocusedIndexPath() : std::nullopt;
}

void Screen::focusPreferredView() {
    layoutIfNeeded();
    if (SettingsTableView* shown = table()) shown->focusPreferredRow();
}

void Screen::viewChanged() {
    if (observer_) observer_->viewsChanged();
}

void Screen::tableReloaded(SettingsTableView& table) {
    if (observer_) observer_->tableReloaded(table);
}

void Screen::tableChanged(SettingsTableView& table, const TableChanges& changes) {
    if (observer_) observer_->tableChanged(table, changes);
}

void Screen::tableScrolled(SettingsTableView& table, Animated animated) {
    if (observer_) observer_->tableScrolled(table, animated);
}

void Screen::focusChanged() {
    if (observer_) observer_->focusChanged();
}

void Screen::note(std::string_view line) {
    if (note_) note_(line);
}

}  // namespace wp::ui
