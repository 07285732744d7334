#include "linux/files/iwd_settings.h"

#include <filesystem>

#include "linux/files/key_value_file.h"

namespace wp {

bool iwdMaySetAddresses(const std::string& root) {
    const std::string path = root + "/etc/iwd/main.conf";
    const auto text = readSmallFile(path);
    std::error_code failed;
    if (!text) return std::filesystem::exists(path, failed);
    UnitFile settings;
    readUnitFile(*text, settings);
    // The second is the older name.
    for (const char* name : {"EnableNetworkConfiguration", "enable_network_config"}) {
        const auto& values = settings["General"][name];
        if (!values.empty()) return values.back() == "true" || values.back() == "1";
    }
    return false;
}

}  // namespace wp
