#include "screens/tv/keyboard.h"

#include <array>
#include <string_view>

#include "platform/ui/display_text.h"

namespace wp::tv {
namespace {

using Layer = std::array<std::string_view, 4>;

constexpr Layer kSmall = {"1234567890-", "qwertyuiop_", "asdfghjkl.'", "zxcvbnm,@!?"};
constexpr Layer kCapital = {"1234567890-", "QWERTYUIOP_", "ASDFGHJKL.'", "ZXCVBNM,@!?"};
constexpr Layer kSymbols = {"!\"#$%&'()*+", ",-./:;<=>?@", "[\\]^_`{|}~€", "äöüßéèàçñåø"};
constexpr Layer kCapitalSymbols = {"!\"#$%&'()*+", ",-./:;<=>?@", "[\\]^_`{|}~€", "ÄÖÜẞÉÈÀÇÑÅØ"};

struct Function {
    Keyboard::Kind kind;
    int width;
};
constexpr std::array kFunctions = std::to_array<Function>({{Keyboard::Kind::shift, 3},
                                                           {Keyboard::Kind::page, 3},
                                                           {Keyboard::Kind::blank, 6},
                                                           {Keyboard::Kind::left, 2},
                                                           {Keyboard::Kind::right, 2},
                                                           {Keyboard::Kind::erase, 3},
                                                           {Keyboard::Kind::done, 3}});

Keyboard::Row rowOf(std::string_view characters) {
    Keyboard::Row row;
    for (int column = 0; !characters.empty(); column += 2)
        row.push_back({Keyboard::Kind::text, std::string(ui::takeCharacter(characters).bytes), column, 2});
    return row;
}

Keyboard::Row functionRow() {
    Keyboard::Row row;
    int column = 0;
    for (const Function& function : kFunctions) {
        row.push_back(
            {function.kind, function.kind == Keyboard::Kind::blank ? " " : "", column, function.width});
        column += function.width;
    }
    return row;
}

}  // namespace

Keyboard::Keyboard() {
    fill();
}

void Keyboard::fill() {
    bool isShifted = shift_ != Shift::off;
    const Layer& layer = showsSymbols_ ? (isShifted ? kCapitalSymbols : kSymbols)
                         : isShifted   ? kCapital
                                       : kSmall;
    rows_.clear();
    for (std::string_view characters : layer) rows_.push_back(rowOf(characters));
    rows_.push_back(functionRow());
}

bool Keyboard::move(ui::Key arrow) {
    bool isAcross = arrow == ui::Key::left || arrow == ui::Key::right;
    std::size_t end = isAcross ? rows_[row_].size() : rows_.size();
    std::size_t& place = isAcross ? key_ : row_;
    bool isBackward = arrow == ui::Key::left || arrow == ui::Key::up;
    if (isBackward ? place == 0 : place + 1 == end) return false;
    isBackward ? --place : ++place;
    if (isAcross) {
        const Key& key = rows_[row_][key_];
        column_ = key.column + key.width / 2;
    } else {
        focusColumn();
    }
    return true;
}

void Keyboard::enterFromBelow() {
    row_ = rows_.size() - 1;
    focusColumn();
}

/// The key of the row that lies over the column.
void Keyboard::focusColumn() {
    key_ = 0;
    while (key_ + 1 < rows_[row_].size() && rows_[row_][key_ + 1].column <= column_) ++key_;
}

Keyboard::Key Keyboard::press() {
    Key pressed = rows_[row_][key_];
    if (pressed.kind == Kind::shift) {
        shift_ = shift_ == Shift::off ? Shift::once : shift_ == Shift::once ? Shift::locked : Shift::off;
    } else if (pressed.kind == Kind::page) {
        showsSymbols_ = !showsSymbols_;
    } else if (pressed.kind == Kind::text && shift_ == Shift::once) {
        shift_ = Shift::off;
    }
    fill();
    return pressed;
}

}  // namespace wp::tv
