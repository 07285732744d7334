#include "screens/tv/keyboard_look.h"

#include "screens/tv/looks.h"

namespace wp::tv {
namespace {

QString text(const char* utf8) {
    return QString::fromUtf8(utf8);
}

QString text(const std::string& utf8) {
    return QString::fromStdString(utf8);
}

/// What stands on the key and how it is read out.
void label(KeyLook& look, const Keyboard::Key& key, const Keyboard& keyboard, const Texts& texts) {
    switch (key.kind) {
        case Keyboard::Kind::text:
            look.label = look.name = text(key.text);
            return;
        case Keyboard::Kind::shift:
            look.label = keyboard.shift() == Keyboard::Shift::locked ? text("\u21EA") : text("\u21E7");
            look.name = text(texts.shift);
            look.isOn = keyboard.shift() != Keyboard::Shift::off;
            return;
        case Keyboard::Kind::page:
            look.label = look.name = text(keyboard.showsSymbols() ? texts.letters : texts.symbols);
            return;
        case Keyboard::Kind::blank:
            look.label = look.name = text(texts.blank);
            return;
        case Keyboard::Kind::left:
            look.label = text("\u2190");
            look.name = text(texts.left);
            return;
        case Keyboard::Kind::right:
            look.label = text("\u2192");
            look.name = text(texts.right);
            return;
        case Keyboard::Kind::erase:
            look.label = text("\u232B");
            look.name = text(texts.backspace);
            return;
        case Keyboard::Kind::done:
            look.label = look.name = text(texts.done);
            return;
    }
}

}  // namespace

QVariantList keyboardLook(const Typist& typist, const Texts& texts, bool isDone) {
    const Keyboard& keyboard = typist.keyboard();
    QVariantList keys;
    for (std::size_t row = 0; row < keyboard.rows().size(); ++row) {
        for (std::size_t number = 0; number < keyboard.rows()[row].size(); ++number) {
            const Keyboard::Key& key = keyboard.rows()[row][number];
            KeyLook look;
            look.row = static_cast<int>(row);
            look.column = key.column;
            look.width = key.width;
            look.isFunction = key.kind != Keyboard::Kind::text;
            look.isEnabled = isDone || key.kind != Keyboard::Kind::done;
            look.isFocused =
                typist.isOnKeyboard() && keyboard.focusedRow() == row && keyboard.focusedKey() == number;
            label(look, key, keyboard, texts);
            keys << QVariant::fromValue(look);
        }
    }
    return keys;
}

}  // namespace wp::tv
