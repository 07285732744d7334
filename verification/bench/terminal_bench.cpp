// From a key to the changed screen on the terminal: the front end runs in a process of its own on a
// pseudo-terminal, the benchmark presses keys at the other end and reads what comes back.

#include <benchmark/benchmark.h>
#include <poll.h>
#include <pty.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <clocale>
#include <cstdlib>
#include <optional>
#include <string>

#include "screens/terminal/terminal_screen.h"
#include "verification/unit/screens/sample_controller.h"

namespace {

using Clock = std::chrono::steady_clock;

constexpr std::string_view kDown = "\x1BOB";
constexpr std::string_view kUp = "\x1BOA";

std::shared_ptr<wp::SampleController> makeController(int networks) {
    auto controller = std::make_shared<wp::SampleController>();
    controller->names.clear();
    for (int i = 0; i < networks; ++i) controller->names.push_back("Network 東京 " + std::to_string(i));
    return controller;
}

int runFrontEnd(int networks) {
    setenv("TERM", "xterm-256color", 1);
    setenv("LC_ALL", "C.UTF-8", 1);
    wp::Activity activity;
    wp::MainQueue queue(activity);
    wp::ui::Screen screen;
    auto controller = makeController(networks);
    auto opened = wp::terminal::TerminalScreen::open(screen, queue);
    if (std::holds_alternative<std::string>(opened)) return 1;
    controller->buildViews();
    screen.setRootViewController(controller);
    screen.focusPreferredView();
    std::get<std::unique_ptr<wp::terminal::TerminalScreen>>(opened)->runUntil([] { return false; });
    return 0;
}

/// A front end in a process of its own, and the other end of its terminal.
class Terminal {
  public:
    explicit Terminal(int networks) {
        winsize size{30, 100, 0, 0};
        child_ = forkpty(&master_, nullptr, nullptr, &size);
        if (child_ == 0) _exit(runFrontEnd(networks));
    }
    ~Terminal() {
        kill(child_, SIGKILL);
        waitpid(child_, nullptr, 0);
        close(master_);
    }
    Terminal(const Terminal&) = delete;
    Terminal& operator=(const Terminal&) = delete;

    void press(std::string_view key) const {
        if (write(master_, key.data(), key.size()) < 0) std::abort();
    }

    /// Reads a picture. Returns when its last byte came; nothing when there is none.
    std::optional<Clock::time_point> readPicture() const {
        if (!readSome(kPatience)) return std::nullopt;
        Clock::time_point last = Clock::now();
        while (readSome(kQuiet)) last = Clock::now();
        return last;
    }

    /// Waits until nothing comes any more, however busy the machine is.
    void settle() const {
        while (readSome(kLongQuiet)) {
        }
    }

  private:
    static constexpr int kLongQuiet = 300;
    static constexpr int kPatience = 10000;
    // A picture comes in several pieces, but without a pause as long as this.
    static constexpr int kQuiet = 10;

    bool readSome(int timeout) const {
        pollfd descriptor{master_, POLLIN, 0};
        if (poll(&descriptor, 1, timeout) <= 0) return false;
        char buffer[65536];
        return read(master_, buffer, sizeof buffer) > 0;
    }

    int master_ = -1;
    pid_t child_ = -1;
};

/// Target: below 5 ms.
void keyToChangedScreen(benchmark::State& state) {
    int networks = static_cast<int>(state.range(0));
    Terminal terminal(networks);
    if (!terminal.readPicture()) return state.SkipWithError("the list was never drawn");
    int position = 0;
    std::string_view key = kDown;
    for (auto _ : state) {
        // A key and its opposite at once would change nothing.
        if (position == networks || position == 0) {
            terminal.settle();
            key = position == 0 ? kDown : kUp;
        }
        position += key == kDown ? 1 : -1;
        auto begin = Clock::now();
        terminal.press(key);
        auto end = terminal.readPicture();
        if (!end) return state.SkipWithError("a key changed nothing");
        state.SetIterationTime(std::chrono::duration<double>(*end - begin).count());
    }
}
BENCHMARK(keyToChangedScreen)
    ->Name("terminal/key_to_changed_screen")
    ->Arg(20)
    ->Arg(1000)
    ->UseManualTime()
    ->Iterations(200)
    ->Unit(benchmark::kMillisecond);

void drawPicture(benchmark::State& state) {
    std::setlocale(LC_CTYPE, "C.UTF-8");
    wp::ui::Screen screen;
    auto controller = makeController(static_cast<int>(state.range(0)));
    controller->buildViews();
    screen.setRootViewController(controller);
    screen.layoutIfNeeded();
    int firstLine = 0;
    for (auto _ : state)
        benchmark::DoNotOptimize(
            wp::terminal::draw(screen, 30, 100, wp::terminal::Charset::unicode, {}, firstLine));
}
BENCHMARK(drawPicture)->Name("terminal/draw_picture")->Arg(20)->Arg(1000)->Unit(benchmark::kMicrosecond);

}  // namespace
