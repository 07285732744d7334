#include "linux/files/key_value_file.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <algorithm>

#include "exchange/descriptor.h"

namespace wp {
namespace {

// Files of the kernel tell no size: they are read by so much at a time.
constexpr std::size_t kPage = 4096;
constexpr std::string_view kBlanks = " \t\r\n";

std::string unquoted(std::string_view text) {
    const bool quoted = text.size() >= 2 && (text[0] == '"' || text[0] == '\'') && text.back() == text[0];
    return std::string(quoted ? text.substr(1, text.size() - 2) : text);
}

/// A line with its continuations: "[SECTION]" or "KEY=VALUE".
void readUnitLine(std::string_view line, std::string& section, UnitFile& into) {
    if (line.starts_with("[") && line.ends_with("]")) {
        section = line.substr(1, line.size() - 2);
        return;
    }
    const std::size_t equals = line.find('=');
    if (equals == line.npos || section.empty()) return;
    auto& values = into[section][std::string(trimmed(line.substr(0, equals)))];
    const std::string_view value = trimmed(line.substr(equals + 1));
    if (value.empty())
        values.clear();
    else
        values.emplace_back(value);
}

}  // namespace

std::optional<std::string> readSmallFile(const std::string& path, std::size_t longest) {
    // A pipe in a file's place must not hold us up.
    const Descriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    struct stat about {};
    if (!file || ::fstat(file.number(), &about) != 0 || !S_ISREG(about.st_mode)) return std::nullopt;
    const std::size_t step = std::max(kPage, static_cast<std::size_t>(about.st_size) + 1);
    std::string content;
    std::size_t size = 0;
    while (size <= longest) {
        if (size == content.size()) content.resize(std::min(size + step, longest + 1));
        const ssize_t count = ::read(file.number(), content.data() + size, content.size() - size);
        if (count < 0) return std::nullopt;
        if (count == 0) break;
        size += static_cast<std::size_t>(count);
    }
    if (size > longest) return std::nullopt;
    content.resize(size);
    return content;
}

std::vector<std::string_view> linesOf(std::string_view text) {
    std::vector<std::string_view> lines;
    while (!text.empty()) {
        const std::size_t end = text.find('\n');
        lines.push_back(text.substr(0, end));
        text.remove_prefix(end == text.npos ? text.size() : end + 1);
    }
    return lines;
}

std::vector<std::string> wordsOf(std::string_view text) {
    std::vector<std::string> words;
    while (true) {
        const std::size_t start = text.find_first_not_of(kBlanks);
        if (start == text.npos) return words;
        text.remove_prefix(start);
        const std::size_t end = text.find_first_of(kBlanks);
        words.emplace_back(text.substr(0, end));
        text.remove_prefix(end == text.npos ? text.size() : end);
    }
}

std::string_view trimmed(std::string_view text) {
    const std::size_t start = text.find_first_not_of(kBlanks);
    if (start == text.npos) return {};
    return text.substr(start, text.find_last_not_of(kBlanks) - start + 1);
}

std::string_view uncommented(std::string_view line) {
    bool isQuoted = false;
    for (std::size_t at = 0; at < line.size(); ++at) {
        if (line[at] == '"') isQuoted = !isQuoted;
        const bool isApart = at == 0 || kBlanks.find(line[at - 1]) != kBlanks.npos;
        if (line[at] == '#' && isApart && !isQuoted) return line.substr(0, at);
    }
    return line;
}

std::map<std::string, std::string> readAssignments(std::string_view text) {
    std::map<std::string, std::string> values;
    for (std::string_view line : linesOf(text)) {
        line = trimmed(line);
        if (line.starts_with("export ")) line = trimmed(line.substr(7));
        const std::size_t equals = line.find('=');
        if (line.starts_with("#") || equals == line.npos) continue;
        values[std::string(trimmed(line.substr(0, equals)))] = unquoted(trimmed(line.substr(equals + 1)));
    }
    return values;
}

void readUnitFile(std::string_view text, UnitFile& into) {
    std::string section, whole;
    for (std::string_view line : linesOf(text)) {
        line = trimmed(line);
        if (line.starts_with("#") || line.starts_with(";")) continue;
        const bool goesOn = line.ends_with("\\");
        if (goesOn) line.remove_suffix(1);
        whole.append(line).append(goesOn ? " " : "");
        if (goesOn) continue;
        readUnitLine(trimmed(whole), section, into);
        whole.clear();
    }
    readUnitLine(trimmed(whole), section, into);
}

}  // namespace wp
