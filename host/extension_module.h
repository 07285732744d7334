#pragma once

#include <filesystem>
#include <optional>
#include <string>

#include "platform/extension.h"

namespace wp::host {

/// The file name of the diagnostic's module; it stands beside the program.
inline constexpr const char* kExtensionFileName = "wifi-profile-extension.so";

/// A diagnostic's module, loaded for the rest of the process: blocks and static objects of its code may
/// outlive every handle, so it is never unloaded.
class ExtensionModule {
  public:
    /// Loads the module at the path, or the one beside the program. Throws `Exit` with a line that says what
    /// is wrong: not found, not loadable (with the loader's reason), without the entry, built for another
    /// version of the interface. *Main*.
    explicit ExtensionModule(const std::optional<std::string>& path);

    /// Has the module make its inputs and controller. Throws `Exit` when it makes none. *Main*.
    ExtensionObjects makeObjects(Platform& platform) const;

  private:
    std::filesystem::path path_;
    ExtensionEntry* entry_ = nullptr;
};

}  // namespace wp::host
