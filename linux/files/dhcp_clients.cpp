#include "linux/files/dhcp_clients.h"

#include <algorithm>
#include <vector>

#include "linux/files/dhcpcd_settings.h"
#include "linux/files/processes.h"

namespace wp {
namespace {

struct Client {
    const char* program;
    bool ipv4;         ///< asks for addresses of IPv4, unless told not to
    bool leavesLease;  ///< sets addresses with their end, and keeps a lease that tells of those without one
    bool asksRouters;  ///< looks at routers' advertisements itself, and has the kernel leave them alone
};
constexpr Client kClients[] = {{"udhcpc", true, false, false},
                               {"udhcpc6", false, false, false},
                               {"dhclient", true, true, false},
                               {"dhcpcd", true, true, true},
                               {"connmand", true, false, true}};

/// A client that names interfaces looks after those, one that names none after all that it finds.
bool looksAfter(const std::vector<std::string>& words, const std::string& interfaceName, Connman connman,
                const std::string& root) {
    const std::string program = programOf(words[0]);
    if (program == "connmand") return connman == Connman::silent;
    const auto names = [&](const std::string& word) {
        return word == interfaceName || word == "-i" + interfaceName;
    };
    if (std::ranges::any_of(words, names)) return true;
    const auto isOption = [](const std::string& word) {
        return word.empty() || word.starts_with("-") || word.starts_with("[") || word.find('/') != word.npos;
    };
    return program == "dhcpcd" && std::all_of(words.begin() + 1, words.end(), isOption) &&
           !dhcpcdPassesOver(interfaceName, root);
}

/// Whether options, or the title, say that only IPv6 is asked for.
bool isForIPv6Alone(const std::vector<std::string>& words) {
    const auto has = [&](const char* word) { return std::ranges::find(words, word) != words.end(); };
    return has("-6") || has("--ipv6only") || (has("[ip6]") && !has("[ip4]"));
}

const Client* clientIn(const std::vector<std::string>& words) {
    for (const std::string& word : words) {
        const Client* found = std::ranges::find(kClients, programOf(word), &Client::program);
        if (found != std::end(kClients)) return found;
    }
    return nullptr;
}

}  // namespace

DhcpClients dhcpClientsOf(const std::string& interfaceName, Connman connman, const std::string& root) {
    DhcpClients clients;
    forEachProcess(root, [&](const std::vector<std::string>& words) {
        const Client* client = clientIn(words);
        if (client == nullptr || !looksAfter(words, interfaceName, connman, root)) return;
        clients.any = true;
        clients.dhcpcd |= std::string_view(client->program) == "dhcpcd";
        const bool ipv4 = client->ipv4 && !isForIPv6Alone(words);
        clients.ipv4 |= ipv4 && !client->leavesLease;
        clients.leavesLease |= ipv4 && client->leavesLease;
        clients.asksRouters |= client->asksRouters;
    });
    return clients;
}

}  // namespace wp
