#pragma once

#include <functional>
#include <map>
#include <string>
#include <vector>

namespace wp {

/// The variables of an environment that set a proxy, each as "WHERE: NAME"; empty ones set none, and exceptions
/// alone (`no_proxy`) neither. *Any* thread.
std::vector<std::string> proxyVariables(const std::map<std::string, std::string>& environment,
                                        const std::string& where);

/// All places where this device sets a proxy outside its connection manager: the environment of this process,
/// the system's environment file, and the desktop's settings. \param root a root folder
std::vector<std::string> findProxies(const std::function<const char*(const char*)>& variable,
                                     const std::string& root = "");

/// The proxy mode in a desktop's settings database: "none", "manual" or "auto"; empty where it is not set, or
/// the bytes are no such database. *Any* thread.
std::string proxyModeInSettingsDatabase(const std::string& bytes);

}  // namespace wp
