#include "host/interruption.h"

#include <poll.h>
#include <pthread.h>
#include <signal.h>
#include <sys/eventfd.h>
#include <sys/signalfd.h>
#include <unistd.h>

#include "host/exit.h"

namespace wp::host {
namespace {

using Clock = std::chrono::steady_clock;

/// How long an interrupted run may take to end by itself: a cancelled service answers at once, so only a
/// thread that hangs outside of it needs as long.
constexpr std::chrono::milliseconds kTimeToEnd{2000};

sigset_t watchedSignals() {
    sigset_t signals;
    sigemptyset(&signals);
    sigaddset(&signals, SIGINT);
    sigaddset(&signals, SIGTERM);
    // A program that was started to outlive its terminal (nohup) has it ignored, and a watched signal is not.
    struct sigaction hangUp {};
    if (sigaction(SIGHUP, nullptr, &hangUp) == 0 && hangUp.sa_handler != SIG_IGN) sigaddset(&signals, SIGHUP);
    return signals;
}

}  // namespace

Interruption::Interruption(Actions actions, std::optional<std::chrono::milliseconds> timeout)
    : actions_(std::move(actions)) {
    if (timeout) deadline_ = Clock::now() + *timeout;
    sigset_t signals = watchedSignals();
    pthread_sigmask(SIG_BLOCK, &signals, nullptr);
    signals_ = signalfd(-1, &signals, SFD_CLOEXEC | SFD_NONBLOCK);
    stop_ = eventfd(0, EFD_CLOEXEC);
    if (signals_ < 0 || stop_ < 0) fail("cannot watch for signals: too many open files");
    thread_ = std::thread([this] { watch(); });
}

Interruption::~Interruption() {
    eventfd_write(stop_, 1);
    thread_.join();
    close(stop_);
    close(signals_);
}

std::optional<int> Interruption::exitStatus() const {
    int signal = signal_;
    if (signal == 0) return std::nullopt;
    return exit_status::signalBase + signal;
}

int Interruption::pollTimeout() const {
    if (!deadline_) return -1;
    auto left = std::chrono::ceil<std::chrono::milliseconds>(*deadline_ - Clock::now()).count();
    return static_cast<int>(std::max<decltype(left)>(left, 0));
}

void Interruption::watch() {
    for (;;) {
        pollfd descriptors[] = {{signals_, POLLIN, 0}, {stop_, POLLIN, 0}};
        int ready = poll(descriptors, 2, pollTimeout());
        if (ready < 0) continue;
        if (descriptors[1].revents) return;
        signalfd_siginfo info{};
        bool isSignal = read(signals_, &info, sizeof info) == sizeof info;
        if (!isSignal && !(deadline_ && Clock::now() >= *deadline_)) continue;
        interrupt(isSignal ? static_cast<int>(info.ssi_signo) : SIGINT);
    }
}

void Interruption::interrupt(int signal) {
    int none = 0;
    if (signal_.compare_exchange_strong(none, signal)) {
        deadline_ = Clock::now() + kTimeToEnd;
        actions_.onInterrupted();
        return;
    }
    actions_.onLeaving();
    _exit(exit_status::signalBase + signal_);
}

}  // namespace wp::host
