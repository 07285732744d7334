#pragma once

#include <termios.h>

#include <memory>
#include <string>
#include <variant>

#include "screens/terminal/canvas.h"
#include "screens/terminal/guard.h"

struct screen;

namespace wp::terminal {

/// A key as the terminal sends it.
struct Input {
    enum class Kind {
        none,
        lost,
        character,
        up,
        down,
        left,
        right,
        pageUp,
        pageDown,
        home,
        end,
        erase,
        remove
    };

    /// `none`: nothing to read at present. `lost`: the terminal is gone.
    Kind kind = Kind::none;
    /// Of `character`; control characters too.
    char32_t character = 0;
};

/// The controlling terminal in full-screen use, from its making to its end. Draws there and nowhere else:
/// standard output stays free for the result. At most one exists. *Main*.
class Session {
  public:
    /// Opens the controlling terminal. The text says, in one line, why it cannot be used as a screen.
    static std::variant<std::unique_ptr<Session>, std::string> open();

    /// Gives the terminal back as it was.
    ~Session();
    Session(const Session&) = delete;
    Session& operator=(const Session&) = delete;

    int descriptor() const { return terminal_; }
    int rows() const;
    int columns() const;
    Charset charset() const { return charset_; }

    /// Shows the picture, which has the size that the session says; sends what differs from before.
    void show(const Canvas& picture);

    /// Takes the next key without waiting.
    Input read();

    /// Takes over the terminal's new size.
    void resize();

    /// Sends all of the next picture: something else has drawn on the terminal.
    void invalidate();

    /// Gives the terminal back for a while.
    void leave();
    void comeBack();

  private:
    struct Lines;

    explicit Session(int terminal);
    bool start(std::string& why);
    void configure();
    void showRow(const Canvas& picture, int row);

    int terminal_;
    termios modes_{};
    Charset charset_ = Charset::ascii;
    bool hasColours_ = false;
    std::FILE* output_ = nullptr;
    std::FILE* input_ = nullptr;
    ::screen* screen_ = nullptr;
    std::unique_ptr<Guard> guard_;
    std::unique_ptr<Canvas> shown_;
};

}  // namespace wp::terminal
