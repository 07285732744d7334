#include "linux/files/dhcp_clients.h"

#include <algorithm>
#include <filesystem>
#include <vector>

#include "linux/files/key_value_file.h"

namespace wp {
namespace {

constexpr const char* kClients[] = {"udhcpc", "udhcpc6", "dhclient", "dhcpcd", "connmand"};

std::vector<std::string> wordsOfCommand(const std::string& line) {
    std::vector<std::string> words(1);
    for (const char c : line) {
        if (c == '\0')
            words.emplace_back();
        else
            words.back() += c;
    }
    return words;
}

/// A client that names interfaces looks after those, one that names none after all.
bool looksAfter(const std::vector<std::string>& words, const std::string& interfaceName) {
    const auto names = [&](const std::string& word) {
        return word == interfaceName || word == "-i" + interfaceName;
    };
    if (std::ranges::any_of(words, names)) return true;
    const std::string program = std::filesystem::path(words[0]).filename().string();
    const auto isOption = [](const std::string& word) {
        return word.empty() || word.starts_with("-") || word.find('/') != word.npos;
    };
    return (program == "dhcpcd" && std::all_of(words.begin() + 1, words.end(), isOption)) ||
           program == "connmand";
}

}  // namespace

bool dhcpClientRuns(const std::string& interfaceName, const std::string& root) {
    std::error_code failed;
    for (const auto& entry : std::filesystem::directory_iterator(root + "/proc", failed)) {
        const std::string folder = entry.path().string(), name = entry.path().filename().string();
        if (name.find_first_not_of("0123456789") != name.npos) continue;
        const auto command = readSmallFile(folder + "/cmdline", 4096);
        if (!command) continue;
        const auto words = wordsOfCommand(*command);
        const bool isClient = std::ranges::any_of(words, [&](const std::string& word) {
            const std::string program = std::filesystem::path(word).filename().string();
            return std::ranges::find(kClients, program) != std::end(kClients);
        });
        if (isClient && looksAfter(words, interfaceName)) return true;
    }
    return false;
}

}  // namespace wp
