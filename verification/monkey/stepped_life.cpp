#include "verification/monkey/life.h"
#include "verification/monkey/player.h"
#include "verification/monkey/watched_screen.h"

namespace wp::monkey {
namespace {

using namespace fakes;
using std::chrono::milliseconds;

/// A life whose every step is thrown by the dice: which queue runs next, and what happens while a background
/// block waits for the service.
class SteppedLife {
  public:
    SteppedLife(std::uint64_t seed, const ScreenMaker& makeScreen)
        : dice_(seed), watched_(makeScreen(dice_, device_.screen, unused_)) {
        device_.service.setRequestHandler([this](const DiagnosticsTestRequest&) { whileWaiting(); });
        device_.service.setStatusHandler([this] { whileWaiting(); });
    }

    int play(int events) {
        player_.start();
        isQuiet_ = false;
        bool isTornDown = false;
        for (played_ = 0; played_ < events && !player_.isOver() && !isTornDown; ++played_) {
            step();
            check();
            isTornDown = dice_.percent(1) && dice_.percent(20);
        }
        finish(isTornDown);
        return played_;
    }

    int played() const { return played_; }

  private:
    void step() {
        int what = dice_.below(10);
        if (what < 5) {
            player_.act();
        } else if (what < 7) {
            device_.queues.runOneOnMain();
        } else if (what < 9) {
            device_.queues.runOneInBackground();
        } else {
            device_.queues.advance(milliseconds(dice_.below(200)));
        }
    }

    /// The main thread goes on, and so may another background block, while one waits. (While the run starts it
    /// is the main thread that waits.)
    void whileWaiting() {
        constexpr int kDeepest = 3;
        if (isQuiet_ || depth_ >= kDeepest || !dice_.percent(20)) return;
        ++depth_;
        if (dice_.percent(30)) device_.queues.runOneInBackground();
        for (int i = dice_.below(4); i > 0; --i) {
            device_.queues.main().async([this] { player_.act(); });
            device_.queues.runOneOnMain();
        }
        --depth_;
    }

    void check() {
        watched_->look();
        player_.check();
    }

    void finish(bool isTornDown) {
        isQuiet_ = true;
        if (!isTornDown) {
            device_.queues.runAll();
            check();
            if (!player_.hasLeft()) checkOutcome(device_.screen, player_.controller());
        }
        player_.controller().teardown();
        device_.queues.runAll();
        check();
        watched_->rest();
    }

    Dice dice_;
    Activity activity_;
    MainQueue unused_{activity_};  // the front end wants one to turn, and never turns it here
    FakeDevice device_;
    std::unique_ptr<WatchedScreen> watched_;
    Player player_{dice_, device_, device_.platform, device_.screen};
    int played_ = 0;
    int depth_ = 0;
    bool isQuiet_ = true;
};

}  // namespace

int playSteppedLife(std::uint64_t seed, int events, const ScreenMaker& makeScreen) {
    SteppedLife life(seed, makeScreen);
    return inLife([&] { return life.play(events); }, [&] { return life.played(); });
}

}  // namespace wp::monkey
