#pragma once

#include <functional>
#include <optional>
#include <string>
#include <string_view>

#include "platform/activity.h"
#include "platform/main_queue.h"
#include "platform/ui/front_end.h"
#include "platform/ui/screen.h"
#include "screens/remote/script.h"

namespace wp::remote {

/// Drives one run to its end: plays a script on any front end, then leaves the run to whoever holds the
/// remote. *Main*.
///
/// Before each step the main queue runs empty. Steps left when the run is over are ignored. While the script
/// plays it is the activity's idle handler.
class RemoteControl {
  public:
    struct Parts {
        ui::Screen& screen;
        ui::FrontEnd& frontEnd;
        MainQueue& queue;
        Activity& activity;
        /// Whether the run is over: finished, left or broken off. Whoever makes it true wakes the queue.
        std::function<bool()> isOver;
        /// Takes one snapshot, a line without its newline.
        std::function<void(std::string_view)> transcript;
    };

    explicit RemoteControl(Parts parts) : parts_(std::move(parts)) {}

    /// Plays the script (an empty one where there is none) and returns when the run is over. Otherwise it
    /// returns, in one line, why the run cannot go on: a step failed, or it waits for a key that can never
    /// come, because nobody can press one on this screen, no work is left and no event is still to come.
    std::optional<std::string> play(const Script& script);

  private:
    std::optional<std::string> perform(const Step& step);
    std::optional<std::string> edit(const Step& step);
    bool isAtRest() const;
    void waitForRest();
    std::optional<std::string> waitForEnd();

    Parts parts_;
};

}  // namespace wp::remote
