#pragma once

#include <sys/types.h>

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <variant>

#include "exchange/json_reader.h"

namespace wp {

/// The content of a file, `-` being standard input; refused where it cannot be read or is longer than so many
/// bytes. *Any* thread.
std::variant<std::string, Refusal> readWholeFile(const std::string& path, std::size_t limit);

/// Writes a file whole or not at all: a new file beside it with these permissions takes its place once
/// everything is on the disk. A symbolic link stays, and the file that it names is replaced; what is no regular file
/// (a pipe, a terminal) is written to directly. Returns why it could not be done; nothing when it was. *Any*
/// thread.
std::optional<Refusal> writeWholeFile(const std::string& path, std::string_view text, mode_t permissions);

}  // namespace wp
