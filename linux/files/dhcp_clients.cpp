#include "linux/files/dhcp_clients.h"

#include <algorithm>
#include <filesystem>
#include <vector>

#include "linux/files/key_value_file.h"

namespace wp {
namespace {

struct Client {
    const char* program;
    bool asksRouters;  ///< looks at routers' advertisements itself, and has the kernel leave them alone
};
constexpr Client kClients[] = {
    {"udhcpc", false}, {"udhcpc6", false}, {"dhclient", false}, {"dhcpcd", true}, {"connmand", true}};

/// The words of a command line. A program that shows a title of its own there ("dhcpcd: wlan0 [ip4]") has one text in
/// place of words, which blanks separate.
std::vector<std::string> wordsOfCommand(const std::string& line) {
    std::vector<std::string> words(1);
    const bool isTitle = line.substr(0, line.find('\0')).find(": ") != line.npos;
    for (const char c : line) {
        if (c == '\0' || (isTitle && c == ' '))
            words.emplace_back();
        else
            words.back() += c;
    }
    if (isTitle && words.front().ends_with(":")) words.front().pop_back();
    return words;
}

std::string programIn(const std::string& word) {
    return std::filesystem::path(word).filename().string();
}

/// A client that names interfaces looks after those, one that names none after all.
bool looksAfter(const std::vector<std::string>& words, const std::string& interfaceName) {
    const auto names = [&](const std::string& word) {
        return word == interfaceName || word == "-i" + interfaceName;
    };
    if (std::ranges::any_of(words, names)) return true;
    const std::string program = programIn(words[0]);
    const auto isOption = [](const std::string& word) {
        return word.empty() || word.starts_with("-") || word.starts_with("[") || word.find('/') != word.npos;
    };
    return (program == "dhcpcd" && std::all_of(words.begin() + 1, words.end(), isOption)) ||
           program == "connmand";
}

const Client* clientIn(const std::vector<std::string>& words) {
    for (const std::string& word : words) {
        const Client* found = std::ranges::find(kClients, programIn(word), &Client::program);
        if (found != std::end(kClients)) return found;
    }
    return nullptr;
}

}  // namespace

DhcpClients dhcpClientsOf(const std::string& interfaceName, const std::string& root) {
    DhcpClients clients;
    std::error_code failed;
    std::filesystem::directory_iterator entry(root + "/proc", failed);
    for (; !failed && entry != std::filesystem::directory_iterator(); entry.increment(failed)) {
        const std::string folder = entry->path().string(), name = entry->path().filename().string();
        if (name.find_first_not_of("0123456789") != name.npos) continue;
        const auto command = readSmallFile(folder + "/cmdline", 4096);
        if (!command) continue;
        const auto words = wordsOfCommand(*command);
        const Client* client = clientIn(words);
        if (client == nullptr || !looksAfter(words, interfaceName)) continue;
        clients.any = true;
        clients.asksRouters |= client->asksRouters;
    }
    return clients;
}

}  // namespace wp
