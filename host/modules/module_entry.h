#pragma once

#include <filesystem>
#include <string>
#include <variant>

namespace wp::host {

/// Where the program's own file stands. *Any*.
std::filesystem::path programFolder();

/// The entry of a module that stands beside the program. The module is loaded for the rest of the process. The text says
/// in one line why there is none. *Any*.
std::variant<void*, std::string> moduleEntry(const char* fileName, const char* entryName);

}  // namespace wp::host
