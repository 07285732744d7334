#pragma once

#include <memory>
#include <string>
#include <variant>

#include "platform/main_queue.h"
#include "platform/ui/front_end.h"
#include "platform/ui/screen.h"
#include "screens/terminal/picture.h"

/// What the host and the terminal screen's module know of each other. The module is loaded only where the screen is
/// wanted, so that no other run needs the terminal's library. Program and module are of one build.
namespace wp::terminal {

inline constexpr const char* kModuleFileName = "wifi-profile-screen-terminal.so";
inline constexpr const char* kEntryName = "wifiProfileTerminalScreen";

/// What the module does. *Main*, but for `restoreNow`.
struct Module {
    /// As `TerminalScreen::open`; the text says in one line why there is no screen.
    std::variant<std::unique_ptr<ui::FrontEnd>, std::string> (*open)(ui::Screen&, MainQueue&, Texts);
    /// As `TerminalScreen::restoreNow`: leaves the terminal as it was. In a signal handler too.
    void (*restoreNow)();
};

/// The module's entry. *Any* thread.
using Entry = const Module*();

}  // namespace wp::terminal
