#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace wp {

/// Bytes that stand in hexadecimal: "4558", or each by itself as in "45:58:a". Nothing for any other text. *Any* thread.
std::optional<std::string> octetsFrom(std::string_view text);

}  // namespace wp
