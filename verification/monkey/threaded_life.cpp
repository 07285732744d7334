#include <atomic>
#include <thread>

#include "screens/headless/headless_screen.h"
#include "verification/monkey/life.h"
#include "verification/monkey/player.h"

namespace wp::monkey {
namespace {

using namespace fakes;
using std::chrono::microseconds;

/// A life on real threads: the service takes its time, and the main thread plays meanwhile.
class ThreadedLife {
  public:
    explicit ThreadedLife(std::uint64_t seed) : dice_(seed) {
        device_.service.setRequestHandler([this](const DiagnosticsTestRequest&) { takeTime(); });
        device_.service.setStatusHandler([this] { takeTime(); });
        device_.activity.setIdleHandler([this] { device_.main.wake(); });
    }
    ~ThreadedLife() { device_.activity.setIdleHandler(nullptr); }

    int play(int events) {
        // Most lives are torn down in the middle; the others are waited for, as a host does.
        bool isTornDown = dice_.percent(90);
        player_.start();
        for (played_ = 0; played_ < events && !player_.isOver(); ++played_) {
            player_.act();
            if (dice_.percent(60)) device_.main.runPending();
            if (dice_.percent(5)) std::this_thread::sleep_for(microseconds(dice_.below(400)));
            check();
        }
        finish(isTornDown);
        return played_;
    }

    int played() const { return played_; }

  private:
    /// Up to a third of a millisecond, other each time, on whatever thread asks.
    void takeTime() {
        constexpr unsigned kMultiplier = 2654435761U;
        unsigned time = (calls_++ * kMultiplier >> 16) % 400;
        if (time > 60) std::this_thread::sleep_for(microseconds(time - 60));
    }

    void check() {
        headless_.draw();
        player_.check();
        if (headless_.faults() != 0) throw Broken("the front end was told other changes than were made");
    }

    void finish(bool isTornDown) {
        auto isIdle = [this] { return device_.activity.idle(); };
        if (!isTornDown) {
            device_.main.runUntil(isIdle);
            check();
            if (!player_.hasLeft()) checkOutcome(device_.screen, player_.controller());
        }
        player_.controller().teardown();
        do {
            device_.background.drain(BackgroundQueue::Delayed::drop);
            device_.main.runPending();
        } while (!isIdle());
        check();
    }

    Dice dice_;
    ThreadedDevice device_;
    headless::HeadlessScreen headless_{device_.screen, device_.main};
    Player player_{dice_, device_, device_.platform, device_.screen};
    std::atomic<unsigned> calls_ = 0;
    int played_ = 0;
};

}  // namespace

int playThreadedLife(std::uint64_t seed, int events) {
    ThreadedLife life(seed);
    return inLife([&] { return life.play(events); }, [&] { return life.played(); });
}

}  // namespace wp::monkey
