#pragma once

#include <memory>
#include <string>
#include <variant>

#include "platform/main_queue.h"
#include "platform/ui/front_end.h"
#include "platform/ui/screen.h"
#include "screens/tv/display.h"
#include "screens/tv/tv_module.h"

namespace wp::tv {

/// The front end on a television: full screen on a desktop or straight on the graphics device. *Main*.
///
/// It mirrors the view tree into a scene, batch by batch, and sends the remote control's keys to it. A window
/// that is closed is the back key. Text is typed on a keyboard, through an input method, or with the five
/// keys on the keyboard of the screen.
class TvScreen final : public ui::FrontEnd {
  public:
    using Opened = std::variant<std::unique_ptr<TvScreen>, std::string>;

    /// Mirrors the screen from now to its end. The text says, in one line, why it cannot. Neither screen nor
    /// queue is kept alive.
    static Opened open(ui::Screen& screen, MainQueue& queue, Texts texts, Display::Messages messages);
    ~TvScreen() override;

    bool runUntil(const std::function<bool()>& condition,
                  std::optional<Clock::time_point> end = std::nullopt) override;
    bool takesKeys() const override { return true; }
    bool isAnimating() const override;
    std::optional<std::string> savePicture(const std::string& file) override;

  private:
    class Loop;

    explicit TvScreen(std::unique_ptr<Loop> loop);

    std::unique_ptr<Loop> loop_;
};

}  // namespace wp::tv
