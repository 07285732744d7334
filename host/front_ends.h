#pragma once

#include <memory>

#include "host/arguments.h"
#include "host/diagnostics_log.h"
#include "platform/localization.h"
#include "platform/main_queue.h"
#include "platform/ui/front_end.h"
#include "platform/ui/screen.h"

namespace wp::host {

/// The front end of the choice, which mirrors the screen from now on. Throws `Exit` (status 2) where it cannot
/// be had. Texts that are the front end's own come from the localization, what it has to say goes to the log.
/// Nothing is kept alive. *Main*.
std::unique_ptr<ui::FrontEnd> makeFrontEnd(ScreenChoice choice, ui::Screen& screen, MainQueue& queue,
                                           const Localization& localization, DiagnosticsLog& log);

/// Gives the terminal back at once, for a process that leaves without unwinding. *Any*.
void restoreTerminal();

}  // namespace wp::host
