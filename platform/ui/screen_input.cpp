// Keys and alerts: what each key does, where it goes.

#include <algorithm>

#include "platform/ui/screen.h"

namespace wp::ui {

void Screen::press(Key key) {
    if (!isInputAccepted()) return;
    keyPressed_ = true;
    if (std::shared_ptr<AlertController> shown = alert()) {
        pressInAlert(*shown, key);
    } else {
        pressInTable(key);
    }
}

void Screen::pressInTable(Key key) {
    if (key == Key::back) {
        if (auto handler = backHandler_) handler();
        return;
    }
    SettingsTableView* shown = table();
    if (!shown) return;
    layoutIfNeeded();
    if (key == Key::up) shown->moveFocus(-1);
    if (key == Key::down) shown->moveFocus(1);
    auto focused = shown->lastFocusedIndexPath();
    if (key == Key::select && focused) shown->pressRow(*focused);
}

void Screen::pressInAlert(AlertController& alert, Key key) {
    TextField* field = alert.focusedTextField();
    if (key == Key::back) return pressBackInAlert(alert);
    if (field && editField(alert, *field, key)) return;
    AlertController::Focus before = alert.focus();
    bool isOnAction = before.on == AlertController::Focus::On::action;
    if (key == Key::up) alert.moveFocus(-1);
    if (key == Key::down) alert.moveFocus(1);
    if (key == Key::left && isOnAction) alert.moveFocusAmongActions(-1);
    if (key == Key::right && isOnAction) alert.moveFocusAmongActions(1);
    if (alert.focus() != before) focusChanged();
    if (key == Key::select && isOnAction) choose(alert, *alert.actions()[before.index]);
}

bool Screen::editField(AlertController& alert, TextField& field, Key key) {
    bool isChanged = false;
    switch (key) {
        case Key::left:
            isChanged = field.moveLeft();
            break;
        case Key::right:
            isChanged = field.moveRight();
            break;
        case Key::home:
            isChanged = field.moveToStart();
            break;
        case Key::end:
            isChanged = field.moveToEnd();
            break;
        case Key::backspace:
            isChanged = field.deleteBackward();
            break;
        case Key::deleteForward:
            isChanged = field.deleteForward();
            break;
        default:
            return false;
    }
    if (isChanged) alertChanged(alert);
    return true;
}

bool Screen::typeText(std::string_view text) {
    std::shared_ptr<AlertController> shown = alert();
    TextField* field = shown ? shown->focusedTextField() : nullptr;
    if (!field || !isInputAccepted()) return false;
    keyPressed_ = true;
    if (field->insert(text)) alertChanged(*shown);
    return true;
}

bool Screen::clearText() {
    std::shared_ptr<AlertController> shown = alert();
    TextField* field = shown ? shown->focusedTextField() : nullptr;
    if (!field || !isInputAccepted()) return false;
    keyPressed_ = true;
    if (field->clear()) alertChanged(*shown);
    return true;
}

void Screen::pressBackInAlert(AlertController& alert) {
    AlertAction* cancel = alert.cancelAction();
    if (cancel) {
        choose(alert, *cancel);
    } else if (alert.hasActionWithoutHandler()) {
        dismissAlert(alert);
    }
    // Otherwise every way out has a consequence, and the viewer must take one of them.
}

void Screen::choose(AlertController& alert, AlertAction& action) {
    if (!action.isEnabled()) return;
    auto keptAlert = std::find_if(alerts_.begin(), alerts_.end(),
                                  [&](const auto& shown) { return shown.get() == &alert; });
    std::shared_ptr<AlertController> alive = keptAlert == alerts_.end() ? nullptr : *keptAlert;
    dismissAlert(alert);
    if (action.handler_) action.handler_(action);
}

void Screen::presentAlert(std::shared_ptr<AlertController> alert, Animated animated) {
    alert->screen_ = this;
    alert->focusFirst();
    alerts_.push_back(std::move(alert));
    AlertController& shown = *alerts_.back();
    if (observer_) observer_->alertPresented(shown, animated);
    focusChanged();
}

void Screen::dismissAlert(AlertController& alert) {
    auto found = std::find_if(alerts_.begin(), alerts_.end(),
                              [&](const auto& shown) { return shown.get() == &alert; });
    if (found == alerts_.end()) return;
    std::shared_ptr<AlertController> alive = *found;
    alerts_.erase(found);
    alive->screen_ = nullptr;
    if (observer_) observer_->alertDismissed(*alive);
    focusChanged();
}

void Screen::alertChanged(AlertController& alert) {
    if (observer_) observer_->alertChanged(alert);
}

}  // namespace wp::ui
