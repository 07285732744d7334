#pragma once

#include <functional>
#include <optional>
#include <string>

#include "host/arguments.h"

namespace wp::host {

/// What the choice of a screen depends on.
struct ScreenSurroundings {
    bool hasTerminal = false;  ///< a person at a terminal sees and presses keys there
    bool hasList = false;      ///< the request asks for the list
    bool hasScript = false;    ///< keys come from a remote-control script
    bool hasDisplay = false;   ///< the environment names a desktop's display
    /// Why there is no television screen in this build; asked only where that screen would be chosen.
    std::function<std::optional<std::string>()> televisionFault = nullptr;
};

/// The screen that the run is drawn on: never `automatic`. Throws `Exit` (status 2) with what to change where
/// the wanted screen cannot do what the run needs. *Any*.
ScreenChoice chooseScreen(ScreenChoice wanted, const ScreenSurroundings& surroundings);

}  // namespace wp::host
