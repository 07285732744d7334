#pragma once

#include <optional>
#include <string>

namespace wp::terminal {

/// What the system's description of a terminal, named by TERM, says.
struct TerminalDescription {
    /// Why it cannot carry a screen, in one line; nothing when it can.
    std::optional<std::string> unfit;
    /// What sets attributes, keypad and cursor back and leaves the drawn screen.
    std::string leavingSequence;
};

/// Reads the description of the terminal of that descriptor. *Main*.
TerminalDescription describeTerminal(int descriptor);

/// A capability without its padding marks (`$<5/>`), which are no characters to be sent.
std::string withoutPadding(std::string capability);

}  // namespace wp::terminal
