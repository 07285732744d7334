#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>

#include "platform/main_queue.h"
#include "platform/ui/front_end.h"
#include "platform/ui/screen.h"

/// What the host and the television screen's module know of each other. The module is loaded only where the
/// screen is wanted, so that no other run needs the toolkit; no type of the toolkit passes between the two.
namespace wp::tv {

/// The file name of the module; it stands beside the program.
inline constexpr const char* kModuleFileName = "wifi-profile-screen-tv.so";
inline constexpr const char* kOpenName = "wifiProfileOpenTvScreen";
/// Raised with every change of `Opening`: program and module are of one build.
inline constexpr int kInterfaceVersion = 1;

/// The screen's own texts, in the user's language.
struct Texts {
    std::string shift;
    std::string symbols;
    std::string letters;
    std::string blank;
    std::string left;
    std::string right;
    std::string backspace;
    std::string done;
};

/// One opening of the screen: what it mirrors, and what comes of it.
struct Opening {
    int version = kInterfaceVersion;
    ui::Screen& screen;
    MainQueue& queue;
    Texts texts = {};
    /// Takes one line about something that the viewer cannot mend. *Any* thread.
    std::function<void(std::string_view)> note = nullptr;
    /// The display is gone for good, and the toolkit will not return: takes the reason and leaves the process.
    /// *Any* thread, no more than one.
    std::function<void(std::string_view)> leave = nullptr;

    std::unique_ptr<ui::FrontEnd> frontEnd = nullptr;
    /// In one line, why there is no front end.
    std::string problem = {};
};

/// The module's entry. Neither screen nor queue is kept alive. *Main*.
using Open = void(Opening& opening);

}  // namespace wp::tv
