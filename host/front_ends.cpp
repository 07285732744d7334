#include "host/front_ends.h"

#include "host/exit.h"

namespace wp::host {
namespace {

/// No screen at all: the run only has its main queue turned.
class NoScreen final : public ui::FrontEnd {
  public:
    explicit NoScreen(MainQueue& queue) : queue_(queue) {}
    bool runUntil(const std::function<bool()>& condition, std::optional<Clock::time_point> end) override {
        return queue_.runUntil(condition, end);
    }
    bool takesKeys() const override { return false; }

  private:
    MainQueue& queue_;
};

}  // namespace

std::unique_ptr<ui::FrontEnd> makeFrontEnd(ScreenChoice choice, ui::Screen& /*screen*/, MainQueue& queue) {
    if (choice != ScreenChoice::none) refuse("--screen: this build has no screen yet; give none");
    return std::make_unique<NoScreen>(queue);
}

void restoreTerminal() {}

}  // namespace wp::host
