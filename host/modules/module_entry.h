#pragma once

#include <filesystem>
#include <string>
#include <variant>

namespace wp::host {

/// Where the program's own file stands. *Any*.
std::filesystem::path programFolder();

/// Why a module cannot be had.
struct ModuleFault {
    enum class Kind { absent, notLoadable, withoutEntry };
    Kind kind;
    std::string reason;  ///< the loader's own words, on one line

    /// In one line, of a module without which the installation is not whole.
    std::string text() const;
};

/// The entry of the module in this file, which is loaded for the rest of the process. Of a bare name, without a folder
/// before it, the loader searches its own folders. *Any*.
std::variant<void*, ModuleFault> moduleEntry(const std::filesystem::path& file, const char* entryName);

}  // namespace wp::host
