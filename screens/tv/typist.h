#pragma once

#include <string_view>

#include "screens/tv/keyboard.h"

namespace wp::tv {

/// What a viewer's keys do: they go to the view tree, but while a text field has the focus the arrows and the
/// select key work the keyboard on the screen. Whoever types on a real keyboard has its arrows move the cursor
/// and its Enter finish, until up is pressed. *Main*.
class Typist {
  public:
    explicit Typist(ui::Screen& screen) : screen_(screen) {}

    void press(ui::Key key);
    /// Text of a real keyboard or an input method.
    void type(std::string_view text);
    /// Another alert: its keyboard begins anew.
    void begin();

    const Keyboard& keyboard() const { return keyboard_; }
    bool isInField() const;
    /// Whether the keyboard's focus is what the next arrow moves.
    bool isOnKeyboard() const { return isInField() && !typesByHand_; }

  private:
    bool hasField() const;
    void pressInField(ui::Key key);
    void pressKeyOfKeyboard();
    void finish();

    ui::Screen& screen_;
    Keyboard keyboard_;
    bool typesByHand_ = false;
};

}  // namespace wp::tv
