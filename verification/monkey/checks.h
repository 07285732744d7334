#pragma once

#include <stdexcept>
#include <string>

#include "lifecycle/wifi_profile_view_controller.h"
#include "platform/ui/screen.h"
#include "verification/monkey/neighbourhood.h"

namespace wp::monkey {

/// Something that must not happen has happened.
struct Broken : std::runtime_error {
    using std::runtime_error::runtime_error;
};

/// Plays, and adds to what is broken after how many events it was.
template <class Play, class Played>
int inLife(Play play, Played played) {
    try {
        return play();
    } catch (const Broken& broken) {
        throw Broken("after event " + std::to_string(played()) + ": " + broken.what());
    }
}

/// Throws `Broken` when the table does not show what the diagnostic has, or a focused row is none. *Main*.
void checkTable(const ui::Screen& screen, const WiFiProfileViewController& controller);

/// For a calm life: throws when the table repaired itself, or a network is shown in two places. *Main*.
void checkCalm(const ui::Screen& screen, const WiFiProfileViewController& controller);

/// Throws unless the run is over with one of the diagnostic's codes, or the screen answers keys. *Main*, with
/// nothing left to run.
void checkOutcome(ui::Screen& screen, WiFiProfileViewController& controller);

}  // namespace wp::monkey
