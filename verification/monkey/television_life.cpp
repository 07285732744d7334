#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>

#include "screens/tv/tv_screen.h"
#include "verification/monkey/checks.h"
#include "verification/monkey/life.h"
#include "verification/monkey/watched_screen.h"

namespace wp::monkey {
namespace {

using std::chrono::milliseconds;

class WatchedTelevision final : public WatchedScreen {
  public:
    WatchedTelevision(Dice& dice, ui::Screen& screen, MainQueue& queue) : dice_(dice) {
        setenv("QT_QPA_PLATFORM", "offscreen", 1);
        setenv("WIFI_PROFILE_TV_SIZE", "1280x720", 1);
        setenv("WIFI_PROFILE_TV_MOTION", "full", 1);
        tv::Display::Messages messages;
        messages.note = [this](std::string_view line) { note_ = line; };
        tv::TvScreen::Opened opened = tv::TvScreen::open(screen, queue, {}, messages);
        if (const std::string* why = std::get_if<std::string>(&opened)) throw Broken(*why);
        tv_ = std::move(std::get<std::unique_ptr<tv::TvScreen>>(opened));
    }

    /// Most changes meet a picture that the one before has not reached yet.
    void look() override {
        constexpr int kLongestLook = 40;  // ms
        if (dice_.percent(20)) tv_->runUntil([] { return true; });
        if (dice_.percent(3)) paintFor(milliseconds(dice_.below(kLongestLook)));
        if (!note_.empty()) throw Broken("the scene is at fault: " + note_);
    }

    void rest() override {
        constexpr std::chrono::seconds kPatience{30};  // the longest motion takes a quarter of a second
        bool rests =
            tv_->runUntil([this] { return !tv_->isAnimating(); }, ui::FrontEnd::Clock::now() + kPatience);
        if (!rests) throw Broken("the picture does not come to rest");
    }

  private:
    void paintFor(milliseconds time) {
        tv_->runUntil([] { return false; }, ui::FrontEnd::Clock::now() + time);
    }

    Dice& dice_;
    std::string note_;
    std::unique_ptr<tv::TvScreen> tv_;
};

/// The events played, or what is broken, as text on the pipe; the first letter says which.
void play(std::uint64_t seed, int events, int pipe) {
    std::string outcome;
    try {
        auto makeScreen = [](Dice& dice, ui::Screen& screen, MainQueue& queue) {
            return std::make_unique<WatchedTelevision>(dice, screen, queue);
        };
        outcome = "+" + std::to_string(playSteppedLife(seed, events, makeScreen));
    } catch (const Broken& broken) {
        outcome = std::string("-") + broken.what();
    }
    if (write(pipe, outcome.data(), outcome.size()) < 0) std::abort();
}

std::string readAll(int pipe) {
    std::string text;
    char bytes[4096];
    for (ssize_t count; (count = read(pipe, bytes, sizeof bytes)) > 0;)
        text.append(bytes, static_cast<std::size_t>(count));
    return text;
}

}  // namespace

int playTelevisionLife(std::uint64_t seed, int events) {
    int ends[2];
    if (pipe(ends) != 0) throw Broken("no pipe to be had");
    pid_t child = fork();
    if (child < 0) throw Broken("no process to be had");
    if (child == 0) {
        play(seed, events, ends[1]);
        _exit(0);
    }
    close(ends[1]);
    std::string outcome = readAll(ends[0]);
    close(ends[0]);
    int status = 0;
    waitpid(child, &status, 0);
    if (outcome.starts_with('-')) throw Broken(outcome.substr(1));
    if (status != 0 || outcome.empty())
        throw Broken("the process ended with status " + std::to_string(status));
    return std::stoi(outcome.substr(1));
}

}  // namespace wp::monkey
