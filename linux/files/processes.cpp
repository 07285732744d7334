#include "linux/files/processes.h"

#include <filesystem>

#include "linux/files/key_value_file.h"

namespace wp {
namespace {

constexpr std::size_t kLongestCommand = 4096;

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

}  // namespace

void forEachProcess(const std::string& root,
                    const std::function<void(const std::vector<std::string>&)>& call) {
    std::error_code failed;
    std::filesystem::directory_iterator entry(root + "/proc", failed);
    for (; !failed && entry != std::filesystem::directory_iterator(); entry.increment(failed)) {
        const std::string folder = entry->path().string(), name = entry->path().filename().string();
        if (name.find_first_not_of("0123456789") != name.npos) continue;
        if (const auto command = readSmallFile(folder + "/cmdline", kLongestCommand))
            call(wordsOfCommand(*command));
    }
}

bool mayRun(const std::string& program, const std::string& root) {
    // The first process is another's, and always there.
    if (!readSmallFile(root + "/proc/1/cmdline", kLongestCommand)) return true;
    bool runs = false;
    forEachProcess(root,
                   [&](const std::vector<std::string>& words) { runs |= programOf(words[0]) == program; });
    return runs;
}

std::string programOf(const std::string& word) {
    return std::filesystem::path(word).filename().string();
}

}  // namespace wp
