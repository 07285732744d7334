#pragma once

#include <memory>
#include <string>
#include <variant>

#include "platform/main_queue.h"
#include "platform/ui/front_end.h"
#include "platform/ui/screen.h"
#include "screens/terminal/picture.h"

namespace wp::terminal {

/// The front end on the controlling terminal. *Main*, but `restoreNow`.
///
/// It draws on `/dev/tty` and nowhere else. As long as it lives nothing else may write to the terminal:
/// whoever has lines for standard error keeps them back until then. Esc is the back key and Enter selects;
/// other keys type where a text field has the focus. Suspended it gives the terminal back, and draws anew when
/// it goes on; when the terminal hangs up it raises SIGHUP once and then runs without keys.
class TerminalScreen final : public ui::FrontEnd {
  public:
    using Opened = std::variant<std::unique_ptr<TerminalScreen>, std::string>;

    /// Opens the terminal and mirrors the screen on it. The text says, in one line, why the terminal cannot be
    /// used. Neither screen nor queue is kept alive.
    static Opened open(ui::Screen& screen, MainQueue& queue, Texts texts = {});

    /// Gives the terminal back as it was.
    ~TerminalScreen() override;

    bool runUntil(const std::function<bool()>& condition,
                  std::optional<Clock::time_point> end = std::nullopt) override;
    bool takesKeys() const override;

    /// Gives the terminal back at once, for a process that leaves without unwinding; nothing when no terminal
    /// screen is open. *Any* thread, and safe in a signal handler.
    static void restoreNow();

  private:
    class Loop;

    explicit TerminalScreen(std::unique_ptr<Loop> loop);

    std::unique_ptr<Loop> loop_;
};

}  // namespace wp::terminal
