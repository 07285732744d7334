#include "screens/tv/console.h"

#include <errno.h>
#include <fcntl.h>
#include <limits.h>
#include <linux/kd.h>
#include <signal.h>
#include <sys/ioctl.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <string_view>

namespace wp::tv {
namespace {

constexpr const char* kForeground = "/dev/tty0";

struct State {
    int console = -1;
    int keyboardMode = K_UNICODE;
    int displayMode = KD_TEXT;
    /// Where it can be opened again: a console that was hung up obeys no descriptor from before.
    char path[PATH_MAX] = {};
};

bool readState(int terminal, State& state) {
    if (terminal < 0 || ioctl(terminal, KDGKBMODE, &state.keyboardMode) != 0) return false;
    if (ioctl(terminal, KDGETMODE, &state.displayMode) != 0) return false;
    if (ttyname_r(terminal, state.path, sizeof state.path) != 0) return false;
    // Standard input is often open for reading alone.
    int console = open(state.path, O_RDWR | O_NOCTTY | O_CLOEXEC);
    state.console = console >= 0 ? console : terminal;
    return true;
}

/// What may be called after a fork among threads, and nothing else.
void restore(const State& state) {
    int console = state.console;
    int unused = 0;
    if (ioctl(console, KDGETMODE, &unused) != 0) console = open(state.path, O_RDWR | O_NOCTTY | O_CLOEXEC);
    ioctl(console, KDSKBMODE, state.keyboardMode);
    ioctl(console, KDSETMODE, state.displayMode);
    // The toolkit hides the cursor, and makes it nothing to be shown.
    constexpr std::string_view showCursor = "\033[?25h\033[?0c";
    [[maybe_unused]] ssize_t written = write(console, showCursor.data(), showCursor.size());
}

/// Waits until no process holds the other end: then the console's user is gone, whatever took it.
[[noreturn]] void watch(int lifeline, const State& state) {
    // Not to fall with the program when all of its name or its process group are killed.
    prctl(PR_SET_NAME, "console-keeper");
    setpgid(0, 0);
    char byte = 0;
    while (read(lifeline, &byte, 1) < 0 && errno == EINTR) {
    }
    restore(state);
    _exit(0);
}

/// The process; -1 where there can be none. It is born with every signal blocked.
pid_t startWatcher(const int (&ends)[2], const State& state) {
    sigset_t all;
    sigset_t before;
    sigfillset(&all);
    pthread_sigmask(SIG_SETMASK, &all, &before);
    pid_t watcher = fork();
    if (watcher == 0) {
        close(ends[1]);
        watch(ends[0], state);
    }
    pthread_sigmask(SIG_SETMASK, &before, nullptr);
    return watcher;
}

}  // namespace

bool Console::isDrawnOverBy(const std::string& platform) {
    return platform.starts_with("linuxfb") || platform.starts_with("eglfs") ||
           platform.starts_with("vkkhrdisplay");
}

std::unique_ptr<Console> Console::take() {
    State state;
    if (!readState(STDIN_FILENO, state) &&
        !readState(open(kForeground, O_RDWR | O_NOCTTY | O_CLOEXEC), state))
        return nullptr;
    int ends[2];
    if (pipe2(ends, O_CLOEXEC) != 0) return nullptr;
    pid_t watcher = startWatcher(ends, state);
    close(ends[0]);
    if (watcher < 0) {
        close(ends[1]);
        return nullptr;
    }
    ioctl(state.console, KDSKBMODE, K_OFF);
    return std::unique_ptr<Console>(new Console(ends[1], watcher));
}

Console::~Console() {
    close(lifeline_);
    while (waitpid(watcher_, nullptr, 0) < 0 && errno == EINTR) {
    }
}

}  // namespace wp::tv
