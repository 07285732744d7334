#pragma once

#include <chrono>
#include <functional>
#include <optional>
#include <string>

namespace wp::ui {

/// A front end as the host sees it: it mirrors the view tree, sends keys to it, and turns the main queue
/// meanwhile. It is the only loop of a run. *Main*.
class FrontEnd {
  public:
    using Clock = std::chrono::steady_clock;

    virtual ~FrontEnd() = default;

    /// Turns the main queue, takes keys and draws until the condition holds or the time is over. The
    /// condition is asked before every wait, and again whenever the main queue is woken. Returns whether it
    /// holds. What is on the screen is up to date when it returns.
    virtual bool runUntil(const std::function<bool()>& condition,
                          std::optional<Clock::time_point> end = std::nullopt) = 0;

    /// Whether a person can press keys here; where nobody can, a run without a script that goes on waits for
    /// nothing.
    virtual bool takesKeys() const = 0;

    /// Whether something on the screen still moves.
    virtual bool isAnimating() const { return false; }

    /// Saves what is shown as a PNG file. Returns why it could not, nothing when it did.
    virtual std::optional<std::string> savePicture(const std::string& /*file*/) {
        return "this screen has no pictures";
    }
};

}  // namespace wp::ui
