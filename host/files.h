#pragma once

#include <filesystem>
#include <optional>
#include <string>

namespace wp::host {

/// Makes sure that descriptors 0 to 2 are open, so that no file of the program's own takes the place of one
/// that was closed: what would be written there fails as it should. *Main*, first of all.
void occupyStandardDescriptors();

/// The whole file, or standard input for "-". Throws `Exit` (status 2) with the option, the file and the
/// reason. *Main*.
std::string readFile(const std::string& option, const std::string& path);

/// Where an installed program keeps a file of `resources/`, whether it is there or not. *Any*.
std::filesystem::path installedResource(const std::filesystem::path& name);

/// A file of the product's `resources/` folder: beside the program, in the source tree around the build
/// folder, or where an installed program keeps it. Nothing where it is in none of them. *Any*.
std::optional<std::filesystem::path> resourceFile(const std::filesystem::path& name);

}  // namespace wp::host
