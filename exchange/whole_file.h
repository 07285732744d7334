#pragma once

#include <cstddef>
#include <string>
#include <variant>

#include "exchange/json_reader.h"

namespace wp {

/// The content of a file, `-` being standard input; refused where it cannot be read or is longer than so many
/// bytes. *Any* thread.
std::variant<std::string, Refusal> readWholeFile(const std::string& path, std::size_t limit);

}  // namespace wp
