#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace wp::remote {

/// One token as it stands in a script, its quotes taken off.
struct RawToken {
    std::string text;
    /// Counted from 1.
    int line = 1;
};

/// A script's tokens, or the reason (with its line) why it cannot be split.
struct Tokens {
    std::vector<RawToken> tokens;
    std::optional<std::string> error;
    int errorLine = 1;
};

/// Splits a script as a shell splits words. *Any* thread.
Tokens splitTokens(std::string_view script);

}  // namespace wp::remote
