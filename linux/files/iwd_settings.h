#pragma once

#include <string>

namespace wp {

/// Whether iwd is told to set addresses itself, or may be: its settings cannot be read. Without settings it does not. *Any*
/// thread.
/// \param root a root folder
bool iwdMaySetAddresses(const std::string& root = "");

}  // namespace wp
