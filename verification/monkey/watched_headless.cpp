#include "screens/headless/headless_screen.h"
#include "verification/monkey/checks.h"
#include "verification/monkey/watched_screen.h"

namespace wp::monkey {
namespace {

class WatchedHeadless final : public WatchedScreen {
  public:
    WatchedHeadless(ui::Screen& screen, MainQueue& queue) : headless_(screen, queue) {}

    void look() override {
        headless_.draw();
        if (headless_.faults() != 0) throw Broken("the front end was told other changes than were made");
    }

  private:
    headless::HeadlessScreen headless_;
};

}  // namespace

std::unique_ptr<WatchedScreen> watchedHeadless(Dice&, ui::Screen& screen, MainQueue& queue) {
    return std::make_unique<WatchedHeadless>(screen, queue);
}

}  // namespace wp::monkey
