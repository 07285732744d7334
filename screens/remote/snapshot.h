#pragma once

#include <string>

#include "platform/ui/screen.h"

namespace wp::remote {

/// What the screen shows, as one line of JSON (keys sorted, no blanks outside texts, no final newline),
/// computed from the view tree alone, so that it is the same on every front end. Names stand in it as they
/// are, not in their display form. *Main*.
std::string snapshot(ui::Screen& screen);

}  // namespace wp::remote
