#include "platform/ui/view_controller.h"

#include "platform/ui/screen.h"

namespace wp::ui {

ViewController::ViewController() : view_(std::make_shared<View>()) {}

ViewController::~ViewController() = default;

void ViewController::setView(std::shared_ptr<View> view) {
    view_->setScreen(nullptr);
    view_ = std::move(view);
    view_->setScreen(screen_);
    if (screen_) screen_->viewChanged();
}

void ViewController::attach(Screen* screen) {
    screen_ = screen;
    view_->setScreen(screen);
    if (!screen) return;
    auto waiting = std::move(waitingAlerts_);
    waitingAlerts_.clear();
    for (auto& alert : waiting) screen->presentAlert(std::move(alert), Animated::no);
}

void ViewController::presentAlert(std::shared_ptr<AlertController> alert, Animated animated) {
    if (screen_) {
        screen_->presentAlert(std::move(alert), animated);
    } else {
        waitingAlerts_.push_back(std::move(alert));
    }
}

std::shared_ptr<AlertController> ViewController::presentedAlert() const {
    if (screen_) return screen_->alert();
    return waitingAlerts_.empty() ? nullptr : waitingAlerts_.back();
}

void ViewController::updateFocusIfNeeded() {
    if (!needsFocusUpdate_) return;
    needsFocusUpdate_ = false;
    if (screen_) screen_->focusPreferredView();
}

void ViewController::becomeFirstResponder() {
    if (screen_) screen_->setFirstResponder(this);
}

bool ViewController::isFirstResponder() const {
    return screen_ && screen_->firstResponder() == this;
}

void ViewController::updateViewConstraints() {
    view_->clearNeedsUpdateConstraints();
}

}  // namespace wp::ui
