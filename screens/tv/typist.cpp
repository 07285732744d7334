#include "screens/tv/typist.h"

namespace wp::tv {

bool Typist::isInField() const {
    auto alert = screen_.alert();
    return alert && alert->focusedTextField();
}

void Typist::begin() {
    keyboard_ = Keyboard();
    typesByHand_ = false;
}

void Typist::type(std::string_view text) {
    if (screen_.typeText(text)) typesByHand_ = true;
}

void Typist::press(ui::Key key) {
    if (isInField()) return pressInField(key);
    screen_.press(key);
    if (key != ui::Key::up || !hasField()) return;
    // Under a keyboard the actions stand side by side: up leads out of their row.
    for (std::size_t left = screen_.alert()->actions().size(); left > 1 && !isInField(); --left)
        screen_.press(key);
    if (isInField() && !typesByHand_) keyboard_.enterFromBelow();
}

bool Typist::hasField() const {
    auto alert = screen_.alert();
    return alert && !alert->textFields().empty();
}

void Typist::pressInField(ui::Key key) {
    using enum ui::Key;
    bool isArrow = key == up || key == down || key == left || key == right;
    if (!isArrow && key != select) return screen_.press(key);
    if (typesByHand_) {
        if (key == select) return finish();
        if (key != up) return screen_.press(key);
        typesByHand_ = false;
    } else if (key == select) {
        pressKeyOfKeyboard();
    } else if (!keyboard_.move(key) && key == down) {
        screen_.press(down);
    }
}

void Typist::pressKeyOfKeyboard() {
    Keyboard::Key pressed = keyboard_.press();
    switch (pressed.kind) {
        case Keyboard::Kind::text:
        case Keyboard::Kind::blank:
            screen_.typeText(pressed.text);
            break;
        case Keyboard::Kind::left:
            screen_.press(ui::Key::left);
            break;
        case Keyboard::Kind::right:
            screen_.press(ui::Key::right);
            break;
        case Keyboard::Kind::erase:
            screen_.press(ui::Key::backspace);
            break;
        case Keyboard::Kind::done:
            finish();
            break;
        default:
            break;
    }
}

/// Goes to the alert's last action, as arrows do, and chooses it; nothing while it is disabled.
void Typist::finish() {
    auto alert = screen_.alert();
    if (!alert || alert->actions().empty() || !alert->actions().back()->isEnabled()) return;
    using Focus = ui::AlertController::Focus;
    const Focus last{Focus::On::action, alert->actions().size() - 1};
    while (alert->focus() != last) {
        Focus before = alert->focus();
        screen_.press(ui::Key::down);
        if (alert->focus() == before) return;
    }
    screen_.press(ui::Key::select);
}

}  // namespace wp::tv
