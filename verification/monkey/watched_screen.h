#pragma once

#include <functional>
#include <memory>

#include "platform/main_queue.h"
#include "platform/ui/screen.h"
#include "verification/monkey/neighbourhood.h"

namespace wp::monkey {

/// The front end of a life, as the monkey watches it. *Main*.
class WatchedScreen {
  public:
    virtual ~WatchedScreen() = default;

    /// After every event. Throws `Broken`.
    virtual void look() = 0;
    /// When nothing is left to run. Throws `Broken` where the picture still moves and will not stop.
    virtual void rest() {}
};

using ScreenMaker = std::function<std::unique_ptr<WatchedScreen>(Dice&, ui::Screen&, MainQueue&)>;

/// The screen without a picture, which compares what it was told with what there is.
std::unique_ptr<WatchedScreen> watchedHeadless(Dice& dice, ui::Screen& screen, MainQueue& queue);

}  // namespace wp::monkey
