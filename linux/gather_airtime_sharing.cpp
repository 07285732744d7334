#include <filesystem>

#include "linux/files/key_value_file.h"
#include "linux/gather_setup.h"

namespace wp {
namespace {

std::optional<std::string> driverOf(const Link& link, const std::string& root) {
    std::error_code failed;
    const auto target = std::filesystem::read_symlink(
        root + "/sys/class/net/" + link.interfaceName + "/device/driver", failed);
    if (failed) return std::nullopt;
    return target.filename().string();
}

/// The parameter of a driver's module that says whether airtime is shared.
struct Switch {
    const char* driver;
    const char* parameter;
};
// Of the drivers that have one that can be read without privileges (kernel documentation of ath9k and iwlwifi, and the
// parameters that the modules of ath9k_htc, iwlegacy and b43 declare).
// clang-format off
constexpr Switch kSwitches[] = {
    {"iwlwifi",   "iwlwifi/parameters/bt_coex_active"},
    {"ath9k",     "ath9k/parameters/btcoex_enable"},
    {"ath9k_htc", "ath9k_htc/parameters/btcoex_enable"},
    {"iwl3945",   "iwlegacy/parameters/bt_coex_active"},
    {"iwl4965",   "iwlegacy/parameters/bt_coex_active"},
    {"b43",       "b43/parameters/btcoex"},
};
// clang-format on

std::optional<bool> switchIn(const std::string& path) {
    const auto text = readSmallFile(path, 64);
    if (!text || text->empty()) return std::nullopt;
    return text->front() == 'Y' || text->front() == '1';
}

/// What rtw88 tells of its part of coexistence. With antennas of its own for each it may share time or not.
std::optional<bool> sharingIn(std::string_view report) {
    const auto has = [&](std::string_view part) { return report.find(part) != report.npos; };
    if (has("[Under Manual Control]") || has("[Coex is STOPPED]") || has("(BT disabled)")) return false;
    return has("= Shared/") ? std::optional(true) : std::nullopt;
}

/// Of the drivers that tell it in the kernel's folder for debugging, where that is mounted and may be looked into.
std::optional<bool> sharingByDebugging(const std::string& driver, const Link& link, const std::string& root) {
    const auto radio = readSmallFile(root + "/sys/class/net/" + link.interfaceName + "/phy80211/name", 64);
    if (!radio) return std::nullopt;
    const std::string folder = root + "/sys/kernel/debug/ieee80211/" + std::string(trimmed(*radio));
    if (driver.starts_with("ath10k_")) return switchIn(folder + "/ath10k/btcoex");
    const auto report =
        driver.starts_with("rtw_8") ? readSmallFile(folder + "/rtw88/coex_info") : std::nullopt;
    return report ? sharingIn(*report) : std::nullopt;
}

}  // namespace

Known<bool> gatherAirtimeSharing(const Link& link, const std::string& root) {
    const auto driver = driverOf(link, root);
    for (const Switch& each : kSwitches)
        if (driver == each.driver)
            if (const auto on = switchIn(root + "/sys/module/" + each.parameter)) return *on;
    if (driver)
        if (const auto shares = sharingByDebugging(*driver, link, root)) return *shares;
    return failure(Reason::unsupported, "the driver " + driver.value_or("(unknown)") +
                                            " does not tell whether it shares airtime with Bluetooth");
}

}  // namespace wp
