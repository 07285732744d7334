#include "platform/ui/alert_controller.h"

#include <algorithm>

#include "platform/ui/screen.h"

namespace wp::ui {

void AlertAction::setEnabled(bool enabled) {
    if (enabled_ == enabled) return;
    enabled_ = enabled;
    if (alert_ && alert_->screen_) alert_->screen_->alertChanged(*alert_);
}

AlertController::~AlertController() {
    for (const auto& action : actions_) action->alert_ = nullptr;
}

void AlertController::addAction(std::shared_ptr<AlertAction> action) {
    action->alert_ = this;
    actions_.push_back(std::move(action));
    if (focus_.on == Focus::On::nothing) focusFirst();
    if (screen_) screen_->alertChanged(*this);
}

void AlertController::addTextField(const std::function<void(TextField&)>& configure) {
    textFields_.push_back(std::make_unique<TextField>());
    if (configure) configure(*textFields_.back());
    if (!screen_) focusFirst();
    if (screen_) screen_->alertChanged(*this);
}

TextField* AlertController::focusedTextField() const {
    return focus_.on == Focus::On::field ? textFields_[focus_.index].get() : nullptr;
}

void AlertController::focusFirst() {
    if (!textFields_.empty()) {
        focus_ = {Focus::On::field, 0};
    } else if (!actions_.empty()) {
        focus_ = {Focus::On::action, 0};
    }
}

void AlertController::moveFocus(int direction) {
    auto fields = static_cast<int>(textFields_.size());
    auto count = fields + static_cast<int>(actions_.size());
    if (count == 0) return;
    int place = static_cast<int>(focus_.index) + (focus_.on == Focus::On::action ? fields : 0);
    place = std::clamp(place + direction, 0, count - 1);
    focus_ = place < fields ? Focus{Focus::On::field, static_cast<std::size_t>(place)}
                            : Focus{Focus::On::action, static_cast<std::size_t>(place - fields)};
}

void AlertController::moveFocusAmongActions(int direction) {
    int last = static_cast<int>(actions_.size()) - 1;
    focus_.index = static_cast<std::size_t>(std::clamp(static_cast<int>(focus_.index) + direction, 0, last));
}

AlertAction* AlertController::cancelAction() const {
    auto found = std::find_if(actions_.begin(), actions_.end(), [](const auto& action) {
        return action->style() == AlertAction::Style::cancel;
    });
    return found == actions_.end() ? nullptr : found->get();
}

bool AlertController::hasActionWithoutHandler() const {
    return std::any_of(actions_.begin(), actions_.end(),
                       [](const auto& action) { return !action->hasHandler(); });
}

}  // namespace wp::ui
