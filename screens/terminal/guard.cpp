#include "screens/terminal/guard.h"

#include <signal.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <atomic>

namespace wp::terminal {
namespace {

constexpr std::array kDeadly = {SIGHUP, SIGINT, SIGQUIT, SIGTERM, SIGABRT, SIGSEGV, SIGBUS, SIGILL, SIGFPE};

// What a signal handler needs, in a form that it may touch.
struct Remembered {
    int terminal = -1;
    termios modes{};
    std::array<char, 256> sequence{};
    std::size_t length = 0;
};
Remembered remembered;
std::atomic<bool> isArmed = false;
static_assert(std::atomic<bool>::is_always_lock_free);

void restoreAndDie(int signal) {
    Guard::restoreNow();
    struct sigaction byDefault {};
    byDefault.sa_handler = SIG_DFL;
    sigaction(signal, &byDefault, nullptr);
    raise(signal);
}

/// Sets the handler where the present one is `from`.
void exchangeHandler(int signal, void (*from)(int), void (*to)(int)) {
    struct sigaction present {};
    sigaction(signal, nullptr, &present);
    if ((present.sa_flags & SA_SIGINFO) != 0 || present.sa_handler != from) return;
    struct sigaction next {};
    next.sa_handler = to;
    sigaction(signal, &next, nullptr);
}

}  // namespace

Guard::Guard(int terminal, const termios& modes, std::string sequence) {
    remembered.terminal = terminal;
    remembered.modes = modes;
    remembered.length = std::min(sequence.size(), remembered.sequence.size());
    std::copy_n(sequence.begin(), remembered.length, remembered.sequence.begin());
    arm();
    for (int signal : kDeadly) exchangeHandler(signal, SIG_DFL, restoreAndDie);
}

Guard::~Guard() {
    for (int signal : kDeadly) exchangeHandler(signal, restoreAndDie, SIG_DFL);
    disarm();
}

void Guard::arm() {
    isArmed = true;
}

void Guard::disarm() {
    isArmed = false;
}

void Guard::restoreNow() {
    if (!isArmed.exchange(false)) return;
    std::size_t done = 0;
    while (done < remembered.length) {
        ssize_t count =
            write(remembered.terminal, remembered.sequence.data() + done, remembered.length - done);
        if (count <= 0) break;
        done += static_cast<std::size_t>(count);
    }
    tcsetattr(remembered.terminal, TCSANOW, &remembered.modes);
}

}  // namespace wp::terminal
