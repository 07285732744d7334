#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "platform/ui/screen.h"

namespace wp::tv {

/// The keyboard on the screen: rows of keys that arrows and the select key work. It knows where its focus is
/// and what a key does, not what is typed into. *Main*.
class Keyboard {
  public:
    enum class Kind { text, shift, page, blank, left, right, erase, done };
    struct Key {
        Kind kind = Kind::text;
        std::string text;  ///< what a key of kind `text` types as it stands now
        int column = 0;    ///< of its left edge
        int width = 2;
    };
    using Row = std::vector<Key>;
    /// All rows are so wide.
    static constexpr int kColumns = 22;

    enum class Shift { off, once, locked };

    Keyboard();

    const std::vector<Row>& rows() const { return rows_; }
    std::size_t focusedRow() const { return row_; }
    std::size_t focusedKey() const { return key_; }
    Shift shift() const { return shift_; }
    bool showsSymbols() const { return showsSymbols_; }

    /// Moves to the key that lies there; false when the arrow leads out of the keyboard.
    bool move(ui::Key arrow);
    /// Puts the focus on the lowest row, under where it was.
    void enterFromBelow();
    /// Presses the focused key. Shift and page take effect at once; what else is pressed is the caller's to do.
    Key press();

  private:
    void fill();
    void focusColumn();

    std::vector<Row> rows_;
    std::size_t row_ = 1;
    std::size_t key_ = 0;
    /// What up and down steer for, so that a wide key on the way does not lead aside.
    int column_ = 1;
    Shift shift_ = Shift::off;
    bool showsSymbols_ = false;
};

}  // namespace wp::tv
