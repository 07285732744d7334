#pragma once

#include <termios.h>

#include <string>

namespace wp::terminal {

/// Gives the terminal back when the process ends without unwinding: by a signal that nobody handles, or
/// because the host calls `restoreNow` before it leaves. At most one exists. *Main*.
class Guard {
  public:
    /// The descriptor of the terminal, its modes as they were, and the sequence that leaves the drawn screen.
    /// Takes the deadly signals whose disposition is the default; each is raised again after its work.
    Guard(int terminal, const termios& modes, std::string sequence);
    ~Guard();
    Guard(const Guard&) = delete;
    Guard& operator=(const Guard&) = delete;

    /// Leaves the drawn screen and sets the modes as they were; nothing when no guard is armed. Safe in a
    /// signal handler. *Any* thread.
    static void restoreNow();

    /// While the drawn screen has been left by other means, there is nothing to give back.
    void arm();
    void disarm();
};

}  // namespace wp::terminal
