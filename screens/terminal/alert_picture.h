#pragma once

#include "platform/ui/alert_controller.h"
#include "screens/terminal/canvas.h"

namespace wp::terminal {

/// Draws the alert as a box in the middle: title, message, text field with the cursor, actions. The focused
/// action is seen by its mark and by reversed colours, a disabled one has no brackets.
void drawAlert(Canvas& canvas, const ui::AlertController& alert);

}  // namespace wp::terminal
