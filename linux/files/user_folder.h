#pragma once

#include <functional>
#include <string>

namespace wp {

/// Where the user's own configuration lies: XDG_CONFIG_HOME, or ".config" in HOME; a folder that is empty or relative
/// counts as none. Empty where there is neither.
/// \param variable a variable of the environment, or null. *Any* thread.
std::string userConfigFolder(const std::function<const char*(const char* name)>& variable);

}  // namespace wp
