#include "screens/terminal/wake.h"

#include <signal.h>
#include <sys/eventfd.h>
#include <unistd.h>

#include <array>
#include <atomic>
#include <cerrno>

namespace wp::terminal {
namespace {

constexpr std::array kWatched = {SIGWINCH, SIGTSTP, SIGCONT};

std::atomic<int> wakeDescriptor = -1;
std::atomic<bool> isResized = false;
std::atomic<bool> isToStop = false;
std::atomic<bool> isContinued = false;

void write(int descriptor) {
    int before = errno;
    if (descriptor >= 0) eventfd_write(descriptor, 1);
    errno = before;
}

void noteSignal(int signal) {
    std::atomic<bool>& flag = signal == SIGWINCH ? isResized : signal == SIGTSTP ? isToStop : isContinued;
    flag = true;
    write(wakeDescriptor);
}

void setHandler(int signal, void (*handler)(int)) {
    struct sigaction action {};
    action.sa_handler = handler;
    action.sa_flags = SA_RESTART;
    sigaction(signal, &action, nullptr);
}

/// A signal that was set to be ignored (a shell without job control does that with SIGTSTP) stays ignored.
void watch(int signal) {
    struct sigaction present {};
    sigaction(signal, nullptr, &present);
    if (present.sa_handler != SIG_IGN) setHandler(signal, noteSignal);
}

void unwatch(int signal) {
    struct sigaction present {};
    sigaction(signal, nullptr, &present);
    if (present.sa_handler == noteSignal) setHandler(signal, SIG_DFL);
}

}  // namespace

Wake::Wake() : descriptor_(eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {
    wakeDescriptor = descriptor_;
    for (std::atomic<bool>* flag : {&isResized, &isToStop, &isContinued}) *flag = false;
    for (int signal : kWatched) watch(signal);
}

Wake::~Wake() {
    for (int signal : kWatched) unwatch(signal);
    wakeDescriptor = -1;
    close(descriptor_);
}

void Wake::wake() const {
    write(descriptor_);
}

void Wake::drain() {
    eventfd_t count = 0;
    eventfd_read(descriptor_, &count);
}

bool Wake::takeResized() {
    return isResized.exchange(false);
}

bool Wake::takeStop() {
    return isToStop.exchange(false);
}

bool Wake::takeContinued() {
    return isContinued.exchange(false);
}

void Wake::stop() {
    setHandler(SIGTSTP, SIG_DFL);
    raise(SIGTSTP);
    setHandler(SIGTSTP, noteSignal);
}

}  // namespace wp::terminal
