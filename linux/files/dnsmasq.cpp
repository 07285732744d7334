#include "linux/files/dnsmasq.h"

#include <algorithm>
#include <filesystem>
#include <set>

#include "linux/files/address_list.h"
#include "linux/files/folder.h"
#include "linux/files/key_value_file.h"
#include "linux/files/leases.h"
#include "linux/files/processes.h"

namespace wp {
namespace {

struct Option {
    char letter;  ///< of the command line
    const char* name;
    bool hasValue;
};
constexpr Option kOptions[] = {
    {'r', "resolv-file", true},    {'R', "no-resolv", false},       {'S', "server", true},
    {'C', "conf-file", true},      {'7', "conf-dir", true},         {'p', "port", true},
    {'a', "listen-address", true}, {'I', "except-interface", true}, {'\0', "servers-file", true},
    {'1', "enable-dbus", false},   {'\0', "local", true},           {'i', "interface", true}};
// Letters of the command line that take no value, so that others may follow in one word.
constexpr std::string_view kFlags = "159DEKLNRZbdefhknoqvwyz";

std::vector<std::string> partsOf(const std::string& list) {
    std::string spaced = list;
    std::ranges::replace(spaced, ',', ' ');
    return wordsOf(spaced);
}

/// "ADDRESS", "ADDRESS#PORT@INTERFACE", or with "/#/" before it; one for some names only counts for nothing.
void addServer(std::string value, DnsmasqSettings& into) {
    if (value.starts_with("/#/")) value.erase(0, 3);
    const std::size_t end = std::min(value.find_first_of("#@"), value.size());
    const auto address = IPAddress::fromText(value.substr(0, end));
    if (!address) return;
    into.servers.push_back(*address);
    const std::string how = value.substr(end);
    if (!how.empty() && how != "#53") into.special.push_back(*address);
}

/// A file may name itself, and others that name it.
void addFile(const std::string& file, DnsmasqSettings& into) {
    const bool isKnown = std::ranges::find(into.files, file) != into.files.end();
    if (!isKnown && into.files.size() < kMostFiles) into.files.push_back(file);
}

bool answersHere(const DnsmasqSettings& settings) {
    const auto isHere = [](const IPAddress& each) { return each.loopback() || each.unspecified(); };
    // To interfaces that it is told of it adds loopback itself.
    return settings.answersAtAll && settings.answersAtUsualPort &&
           (settings.listensAt.empty() || settings.namesInterfaces ||
            std::ranges::any_of(settings.listensAt, isHere));
}

void set(const std::string& name, const std::string& value, DnsmasqSettings& into) {
    if (name == "resolv-file") into.resolverFiles.push_back(value);
    if (name == "no-resolv") into.readsResolverFiles = false;
    if (name == "server" || name == "local") addServer(value, into);
    if (name == "conf-file" || name == "servers-file") addFile(value, into);
    if (name == "conf-dir" && into.folders.size() < kMostFiles) into.folders.push_back(value);
    if (name == "enable-dbus") into.heedsBus = true;
    if (name == "port") into.answersAtUsualPort = value == "53";
    if (name == "interface") into.namesInterfaces = true;
    if (name == "listen-address") add(into.listensAt, addressesIn(value));
    if (name == "except-interface" && std::ranges::count(partsOf(value), "lo") != 0)
        into.answersAtAll = false;
}

/// A word of the command line without letters that others follow: "-kR", "-kS9.9.9.9".
std::string withoutFlags(std::string word, DnsmasqSettings& into) {
    while (word.size() > 2 && word[0] == '-' && kFlags.find(word[1]) != kFlags.npos) {
        if (word[1] == 'R') into.readsResolverFiles = false;
        if (word[1] == '1') into.heedsBus = true;
        word.erase(1, 1);
    }
    return word;
}

/// "PATH,.old,*.conf": whether a file of the folder counts.
bool counts(const std::string& file, const std::vector<std::string>& endings) {
    if (file.starts_with(".") || file.ends_with("~") || (file.starts_with("#") && file.ends_with("#")))
        return false;
    bool wanted = true;
    for (const std::string& each : endings) {
        if (!each.starts_with("*")) {
            if (file.ends_with(each)) return false;
            continue;
        }
        if (file.ends_with(each.substr(1))) return true;
        wanted = false;
    }
    return wanted;
}

std::vector<std::string> filesOf(const std::string& folder, const std::string& root) {
    auto parts = partsOf(folder);
    if (parts.empty()) return {};
    const std::string path = parts[0];
    parts.erase(parts.begin());
    std::vector<std::string> files;
    for (const std::string& name : namesIn(root + path))
        if (counts(name, parts)) files.push_back(path + "/" + name);
    return files;
}

/// All settings of a process: of its command line, and of the files that it and they name.
DnsmasqSettings settingsOf(const std::vector<std::string>& command, const std::string& root) {
    DnsmasqSettings settings;
    readDnsmasqCommand(command, settings);
    if (settings.readsDefaultFile) addFile("/etc/dnsmasq.conf", settings);
    std::size_t file = 0, folder = 0;
    while (file < settings.files.size() || folder < settings.folders.size()) {
        if (folder < settings.folders.size()) {
            for (const std::string& each : filesOf(settings.folders[folder++], root)) addFile(each, settings);
            continue;
        }
        if (const auto text = readSmallFile(root + settings.files[file++])) readDnsmasqFile(*text, settings);
    }
    return settings;
}

/// Of several files it goes by the one that was written last.
std::string newestOf(const std::vector<std::string>& files, const std::string& root) {
    const auto writtenAt = [&](const std::string& file) {
        std::error_code failed;
        const auto at = std::filesystem::last_write_time(root + file, failed);
        return failed ? std::filesystem::file_time_type::min() : at;
    };
    return files.empty() ? "/etc/resolv.conf" : *std::ranges::max_element(files, {}, writtenAt);
}

DnsmasqServers serversOf(const DnsmasqSettings& settings, const std::string& root) {
    DnsmasqServers servers{without(settings.servers, settings.special), settings.servers, settings.heedsBus};
    if (!settings.readsResolverFiles) return servers;
    const auto text = readSmallFile(root + newestOf(settings.resolverFiles, root));
    for (const IPAddress& each : text ? serversFromResolverFile(*text) : std::vector<IPAddress>())
        if (!each.loopback()) servers.asked.push_back(each);
    return servers;
}

}  // namespace

void readDnsmasqFile(std::string_view text, DnsmasqSettings& into) {
    for (std::string_view line : linesOf(text)) {
        line = trimmed(uncommented(line));
        const std::size_t equals = line.find('=');
        std::string value(equals == line.npos ? "" : trimmed(line.substr(equals + 1)));
        std::erase(value, '"');
        set(std::string(trimmed(line.substr(0, equals))), value, into);
    }
}

void readDnsmasqCommand(const std::vector<std::string>& words, DnsmasqSettings& into) {
    for (std::size_t i = 1; i < words.size(); ++i) {
        const std::string word = withoutFlags(words[i], into);
        const std::size_t equals = word.find('=');
        const bool isLong = word.starts_with("--");
        if (word.size() < 2 || word[0] != '-') continue;
        const auto option = std::ranges::find_if(kOptions, [&](const Option& each) {
            return isLong ? word.substr(2, equals - 2) == each.name : each.letter == word[1];
        });
        if (option == std::end(kOptions)) continue;
        std::string value;
        if (isLong && equals != word.npos)
            value = word.substr(equals + 1);
        else if (!isLong && word.size() > 2)
            value = word.substr(2);
        // The long form of one option does without a value.
        else if (option->hasValue && !(isLong && option->letter == 'C') && i + 1 < words.size())
            value = words[++i];
        set(option->name, value, into);
        if (option->letter == 'C') into.readsDefaultFile = false;
    }
}

std::optional<DnsmasqServers> dnsmasqServers(const std::string& root) {
    // One that runs scripts has a helper with the same command line.
    std::set<std::vector<std::string>> commands;
    forEachProcess(root, [&](const std::vector<std::string>& command) {
        if (programOf(command[0]) == "dnsmasq") commands.insert(command);
    });
    std::vector<DnsmasqServers> all;
    for (const auto& command : commands) {
        const DnsmasqSettings settings = settingsOf(command, root);
        DnsmasqServers servers = serversOf(settings, root);
        const bool isToldServers = !servers.asked.empty() || !servers.entered.empty();
        if (answersHere(settings) && (servers.heedsBus || isToldServers)) all.push_back(std::move(servers));
    }
    if (all.size() != 1 || (all[0].asked.empty() && all[0].entered.empty())) return std::nullopt;
    return all[0];
}

}  // namespace wp
