#include "linux/files/dhcpcd_settings.h"

#include <algorithm>

#include "linux/files/address_list.h"
#include "linux/files/key_value_file.h"

namespace wp {
namespace {

/// For what the lines count that are read.
enum class Scope { here, profile, elsewhere };

void addAddresses(std::string_view list, std::vector<IPAddress>& addresses) {
    std::string unquoted(list);
    std::erase(unquoted, '"');
    add(addresses, addressesIn(unquoted));
}

void enter(std::string_view address, FamilyPlan& plan) {
    addAddresses(address, plan.addresses);
    if (!plan.addresses.empty()) plan.method = "manual";
}

/// "ip_address=ADDRESS/BITS", "domain_name_servers=ADDRESS ADDRESS"
void readStatic(std::string_view setting, Scope scope, InterfacePlan& plan) {
    const std::size_t equals = setting.find('=');
    if (equals == setting.npos) return;
    const std::string_view name = trimmed(setting.substr(0, equals)), value = setting.substr(equals + 1);
    if (name == "ip_address") enter(value, plan.ipv4);
    if (name == "ip6_address") enter(value, plan.ipv6);
    const bool isServers = name == "domain_name_servers" || name == "dhcp6_name_servers";
    if (isServers && scope == Scope::here) addAddresses(value, plan.servers);
}

}  // namespace

InterfacePlan readDhcpcdSettings(std::string_view text, std::string_view interfaceName,
                                 std::string_view networkName) {
    InterfacePlan plan;
    Scope scope = Scope::here;
    for (std::string_view line : linesOf(text)) {
        line = trimmed(line);
        const std::size_t blank = line.find_first_of(" \t");
        const std::string_view keyword = line.substr(0, blank);
        const std::string_view rest = blank == line.npos ? "" : trimmed(line.substr(blank));
        if (keyword == "interface") scope = rest == interfaceName ? Scope::here : Scope::elsewhere;
        if (keyword == "ssid") scope = rest == networkName ? Scope::here : Scope::elsewhere;
        if (keyword == "profile") scope = Scope::profile;
        if (scope == Scope::elsewhere) continue;
        if (keyword == "inform") enter(rest, plan.ipv4);
        if (keyword == "static") readStatic(rest, scope, plan);
    }
    return plan;
}

InterfacePlan dhcpcdPlan(const std::string& interfaceName, const std::string& networkName,
                         const std::string& root) {
    const auto text = readSmallFile(root + "/etc/dhcpcd.conf");
    return text ? readDhcpcdSettings(*text, interfaceName, networkName) : InterfacePlan{};
}

}  // namespace wp
