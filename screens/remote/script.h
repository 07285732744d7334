#pragma once

#include <chrono>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace wp::remote {

/// What one token of a remote-control script does.
enum class Action { up, down, left, right, select, back, type, clear, wait, sleep, screen, shot };

/// One token of a script.
struct Step {
    Action action = Action::wait;
    /// The text of `type`, the file of `shot`; otherwise empty.
    std::string text;
    /// The time of `sleep`.
    std::chrono::milliseconds time{0};
    /// Where the token stands, for messages: `token 3 "type:x"`, with file and line before it when it stands
    /// in a file.
    std::string place;
};

/// Whether `shot` is to be had on the screen that the script will drive.
enum class Pictures { refused, taken };

/// A script, or why it is none.
struct Script {
    std::vector<Step> steps;
    /// One line with place and reason; nothing when the script is acceptable. The steps are then empty.
    std::optional<std::string> error;
};

/// Reads the argument of `--remote`: tokens separated by blanks and quoted as in a shell (`'…'`, `"…"`, `\`;
/// `#` at the start of a token begins a comment up to the line's end). A token `@FILE` stands for the tokens
/// of that file, which names no further file. *Any* thread.
Script readScript(std::string_view argument, Pictures pictures);

}  // namespace wp::remote
