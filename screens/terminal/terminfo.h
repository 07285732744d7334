#pragma once

#include <optional>
#include <string>

namespace wp::terminal {

/// Why the terminal of that descriptor cannot carry a screen, in one line; nothing when it can. Loads its
/// description, by TERM. *Main*.
std::optional<std::string> whyUnfit(int descriptor);

/// What sets the attributes, the keypad and the cursor back and leaves the drawn screen, by the description
/// that `whyUnfit` loaded. *Main*.
std::string leavingSequence();

/// A capability without its padding marks (`$<5/>`), which are no characters to be sent.
std::string withoutPadding(std::string capability);

}  // namespace wp::terminal
