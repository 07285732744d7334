#include "linux/files/user_folder.h"

namespace wp {

std::string userConfigFolder(const std::function<const char*(const char* name)>& variable) {
    const char* const folder = variable("XDG_CONFIG_HOME");
    if (folder != nullptr && *folder == '/') return folder;
    const char* const home = variable("HOME");
    return home != nullptr && *home == '/' ? std::string(home) + "/.config" : std::string();
}

}  // namespace wp
