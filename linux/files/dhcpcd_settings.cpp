#include "linux/files/dhcpcd_settings.h"

#include <fnmatch.h>

#include <algorithm>
#include <map>
#include <optional>

#include "linux/files/address_list.h"
#include "linux/files/key_value_file.h"

namespace wp {
namespace {

/// Calls with the word that each line begins with, and what stands behind it.
template <class Visit>
void forEachSetting(std::string_view text, Visit visit) {
    for (std::string_view line : linesOf(text)) {
        line = trimmed(uncommented(line));
        const std::size_t blank = line.find_first_of(" \t");
        visit(line.substr(0, blank), blank == line.npos ? std::string_view() : trimmed(line.substr(blank)));
    }
}

std::optional<std::string> settingsFile(const std::string& root) {
    return readSmallFile(root + "/etc/dhcpcd.conf");
}

bool matchesOneOf(std::string patterns, const std::string& interfaceName) {
    std::ranges::replace(patterns, ',', ' ');
    return std::ranges::any_of(wordsOf(patterns), [&](const std::string& each) {
        return ::fnmatch(each.c_str(), interfaceName.c_str(), 0) == 0;
    });
}

/// For what the lines count that are read.
enum class Scope { here, profile, elsewhere };

/// Values by the names of their options.
using Entered = std::map<std::string, std::vector<IPAddress>>;

/// "ip_address=ADDRESS/BITS", "domain_name_servers=ADDRESS ADDRESS", over what was set before; any profile may come to count.
void set(std::string_view setting, Scope scope, Entered& entered) {
    const std::size_t equals = setting.find('=');
    if (equals == setting.npos) return;
    std::string value(setting.substr(equals + 1));
    std::erase(value, '"');
    auto& addresses = entered[std::string(trimmed(setting.substr(0, equals)))];
    if (scope == Scope::here) addresses.clear();
    add(addresses, addressesIn(value));
}

FamilyPlan planFrom(std::vector<IPAddress> addresses, const std::vector<IPAddress>& ofProfiles) {
    add(addresses, ofProfiles);
    return {addresses.empty() ? "" : "manual", std::move(addresses)};
}

}  // namespace

InterfacePlan readDhcpcdSettings(std::string_view text, std::string_view interfaceName,
                                 std::string_view networkName) {
    Entered here, profiles;
    Scope scope = Scope::here;
    forEachSetting(text, [&](std::string_view keyword, std::string_view rest) {
        if (keyword == "interface") scope = rest == interfaceName ? Scope::here : Scope::elsewhere;
        if (keyword == "ssid") scope = rest == networkName ? Scope::here : Scope::elsewhere;
        if (keyword == "profile") scope = Scope::profile;
        if (scope == Scope::elsewhere) return;
        Entered& entered = scope == Scope::here ? here : profiles;
        if (keyword == "static") set(rest, scope, entered);
        if (keyword == "inform") set("ip_address=" + std::string(rest), scope, entered);
    });
    InterfacePlan plan;
    plan.ipv4 = planFrom(here["ip_address"], profiles["ip_address"]);
    plan.ipv6 = planFrom(here["ip6_address"], profiles["ip6_address"]);
    plan.servers = here["domain_name_servers"];
    add(plan.servers, here["dhcp6_name_servers"]);
    return plan;
}

InterfacePlan dhcpcdPlan(const std::string& interfaceName, const std::string& networkName,
                         const std::string& root) {
    const auto text = settingsFile(root);
    return text ? readDhcpcdSettings(*text, interfaceName, networkName) : InterfacePlan{};
}

bool dhcpcdPassesOver(const std::string& interfaceName, const std::string& root) {
    std::string allowed, denied;
    if (const auto text = settingsFile(root))
        forEachSetting(*text, [&](std::string_view keyword, std::string_view rest) {
            if (keyword == "allowinterfaces") allowed.append(" ").append(rest);
            if (keyword == "denyinterfaces") denied.append(" ").append(rest);
        });
    return matchesOneOf(denied, interfaceName) || (!allowed.empty() && !matchesOneOf(allowed, interfaceName));
}

}  // namespace wp
