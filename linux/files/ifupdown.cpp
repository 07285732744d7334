#include "linux/files/ifupdown.h"

#include <glob.h>

#include <algorithm>
#include <filesystem>

#include "linux/files/folder.h"
#include "linux/files/interfaces_file.h"
#include "linux/files/key_value_file.h"

namespace wp {
namespace {

constexpr const char* kFile = "/etc/network/interfaces";
// ifupdown's, ifupdown-ng's and busybox's: small images have a folder of its own there.
constexpr const char* kStateFiles[] = {"/run/network/ifstate", "/run/ifstate", "/var/run/ifstate"};

/// A folder's files count whose names are words; editors and packages leave others there.
bool isPlainName(const std::string& name) {
    return std::ranges::all_of(name,
                               [](unsigned char c) { return std::isalnum(c) != 0 || c == '_' || c == '-'; });
}

std::vector<std::string> filesIn(const std::string& pattern, bool isFolder) {
    std::vector<std::string> files;
    ::glob_t found{};
    if (::glob((isFolder ? pattern + "/*" : pattern).c_str(), 0, nullptr, &found) == 0)
        for (std::size_t i = 0; i < found.gl_pathc && files.size() < kMostFiles; ++i) {
            const std::filesystem::path path = found.gl_pathv[i];
            if (!isFolder || isPlainName(path.filename())) files.push_back(path);
        }
    ::globfree(&found);
    return files;
}

/// The file with all that it includes, each file once: two may include each other.
InterfacesFile readAll(const std::string& root) {
    InterfacesFile all;
    std::vector<std::string> paths{root + kFile};
    for (std::size_t at = 0; at < paths.size() && at < kMostFiles; ++at) {
        const auto text = readSmallFile(paths[at]);
        if (!text) continue;
        all.includes.clear();
        readInterfaces(*text, all);
        const std::string folder = std::filesystem::path(paths[at]).parent_path();
        for (const InterfacesInclude& each : all.includes) {
            const bool isAbsolute = each.path.starts_with("/");
            for (std::string& path : filesIn((isAbsolute ? root : folder + "/") + each.path, each.isFolder))
                if (std::ranges::find(paths, path) == paths.end()) paths.push_back(std::move(path));
        }
    }
    return all;
}

/// The logical name under which it was started: "wlan0=home". Empty where it was not.
std::string startedAs(const std::string& interfaceName, const std::string& root) {
    for (const char* file : kStateFiles) {
        const auto text = readSmallFile(root + file);
        if (!text) continue;
        for (const std::string_view line : linesOf(*text)) {
            const auto words = wordsOf(line);
            if (!words.empty() && words[0].starts_with(interfaceName + "="))
                return words[0].substr(interfaceName.size() + 1);
        }
    }
    return "";
}

}  // namespace

InterfacePlan ifupdownPlan(const std::string& interfaceName, const std::string& root) {
    const std::string started = startedAs(interfaceName, root);
    return started.empty() ? InterfacePlan{} : planIn(readAll(root), started);
}

}  // namespace wp
