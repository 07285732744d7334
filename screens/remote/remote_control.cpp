#include "screens/remote/remote_control.h"

#include <chrono>

#include "screens/remote/snapshot.h"

namespace wp::remote {
namespace {

std::optional<ui::Key> keyOf(Action action) {
    switch (action) {
        case Action::up:
            return ui::Key::up;
        case Action::down:
            return ui::Key::down;
        case Action::left:
            return ui::Key::left;
        case Action::right:
            return ui::Key::right;
        case Action::select:
            return ui::Key::select;
        case Action::back:
            return ui::Key::back;
        default:
            return std::nullopt;
    }
}

/// Wakes the queue's loop whenever the last work has ended, as long as it lives.
class WakeWhenIdle {
  public:
    WakeWhenIdle(Activity& activity, MainQueue& queue) : activity_(activity) {
        activity_.setIdleHandler([&queue] { queue.wake(); });
    }
    ~WakeWhenIdle() { activity_.setIdleHandler(nullptr); }
    WakeWhenIdle(const WakeWhenIdle&) = delete;
    WakeWhenIdle& operator=(const WakeWhenIdle&) = delete;

  private:
    Activity& activity_;
};

}  // namespace

std::optional<std::string> RemoteControl::play(const Script& script) {
    WakeWhenIdle wakeWhenIdle(parts_.activity, parts_.queue);
    for (const Step& step : script.steps) {
        parts_.queue.runPending();
        if (parts_.isOver()) return std::nullopt;
        if (auto reason = perform(step)) return step.place + ": " + *reason;
    }
    return waitForEnd();
}

std::optional<std::string> RemoteControl::perform(const Step& step) {
    if (auto key = keyOf(step.action)) {
        parts_.screen.press(*key);
        return std::nullopt;
    }
    switch (step.action) {
        case Action::wait:
            waitForRest();
            break;
        case Action::sleep:
            parts_.frontEnd.runUntil(parts_.isOver, ui::FrontEnd::Clock::now() + step.time);
            break;
        case Action::screen:
            parts_.transcript(snapshot(parts_.screen));
            break;
        case Action::shot:
            return parts_.frontEnd.savePicture(step.text);
        default:
            return edit(step);
    }
    return std::nullopt;
}

std::optional<std::string> RemoteControl::edit(const Step& step) {
    bool isDone =
        step.action == Action::clear ? parts_.screen.clearText() : parts_.screen.typeText(step.text);
    if (!isDone) return "no text field has the focus";
    return std::nullopt;
}

bool RemoteControl::isAtRest() const {
    return parts_.activity.idle() && !parts_.frontEnd.isAnimating();
}

void RemoteControl::waitForRest() {
    parts_.frontEnd.runUntil([this] { return parts_.isOver() || isAtRest(); });
}

std::optional<std::string> RemoteControl::waitForEnd() {
    auto isStuck = [this] {
        return !parts_.frontEnd.takesKeys() && isAtRest() && !parts_.queue.hasEventsToCome();
    };
    parts_.frontEnd.runUntil([&] { return parts_.isOver() || isStuck(); });
    if (parts_.isOver()) return std::nullopt;
    return "the run waits for a key, and on this screen nobody can press one";
}

}  // namespace wp::remote
