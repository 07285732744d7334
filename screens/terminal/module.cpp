#include "screens/terminal/terminal_module.h"
#include "screens/terminal/terminal_screen.h"

namespace wp::terminal {
namespace {

std::variant<std::unique_ptr<ui::FrontEnd>, std::string> open(ui::Screen& screen, MainQueue& queue,
                                                              Texts texts) {
    TerminalScreen::Opened opened = TerminalScreen::open(screen, queue, std::move(texts));
    if (std::string* why = std::get_if<std::string>(&opened)) return std::move(*why);
    return std::get<std::unique_ptr<TerminalScreen>>(std::move(opened));
}

constexpr Module kModule = {open, TerminalScreen::restoreNow};

}  // namespace
}  // namespace wp::terminal

// The module's entry: all that the host sees of it.
extern "C" __attribute__((visibility("default"))) const wp::terminal::Module* wifiProfileTerminalScreen() {
    return &wp::terminal::kModule;
}
