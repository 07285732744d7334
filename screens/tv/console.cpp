#include "screens/tv/console.h"

#include <fcntl.h>
#include <linux/kd.h>
#include <signal.h>
#include <sys/ioctl.h>
#include <termios.h>
#include <unistd.h>

namespace wp::tv {
namespace {

struct State {
    int keyboardMode = K_UNICODE;
    int displayMode = KD_TEXT;
    termios modes{};
};

void restore(const State& state) {
    ioctl(STDIN_FILENO, KDSKBMODE, state.keyboardMode);
    ioctl(STDIN_FILENO, KDSETMODE, state.displayMode);
    tcsetattr(STDIN_FILENO, TCSANOW, &state.modes);
}

/// Waits until no process holds the other end: then the console's user is gone, whatever took it. Only what
/// may be called after a fork among threads is called.
[[noreturn]] void watch(int lifeline, const State& state) {
    sigset_t all;
    sigfillset(&all);
    sigprocmask(SIG_BLOCK, &all, nullptr);
    char byte = 0;
    while (read(lifeline, &byte, 1) > 0) {
    }
    restore(state);
    _exit(0);
}

}  // namespace

Console::Console() {
    State state;
    if (ioctl(STDIN_FILENO, KDGKBMODE, &state.keyboardMode) != 0) return;
    ioctl(STDIN_FILENO, KDGETMODE, &state.displayMode);
    tcgetattr(STDIN_FILENO, &state.modes);
    int ends[2];
    if (pipe2(ends, O_CLOEXEC) != 0) return;
    if (fork() == 0) {
        close(ends[1]);
        watch(ends[0], state);
    }
    close(ends[0]);
    lifeline_ = ends[1];
}

Console::~Console() {
    if (lifeline_ >= 0) close(lifeline_);
}

}  // namespace wp::tv
