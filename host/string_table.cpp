#include "host/string_table.h"

#include "host/string_table_sources.h"

namespace wp::host {
namespace {

std::string_view trimmed(std::string_view text) {
    std::size_t first = text.find_first_not_of(" \t\r");
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(" \t\r") - first + 1);
}

std::string withLineBreaks(std::string_view text) {
    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text.substr(i, 2) == "\\n") {
            result += '\n';
            ++i;
        } else {
            result += text[i];
        }
    }
    return result;
}

/// Each text is its key, and a format shows its argument after one blank.
StringTable keysTable() {
    StringTable table = parseStringTable(kStringTableSources[0].text);
    for (auto& [key, text] : table) text = text.find("%@") == std::string::npos ? key : key + " %@";
    return table;
}

}  // namespace

StringTable parseStringTable(std::string_view text) {
    StringTable table;
    while (!text.empty()) {
        std::size_t end = std::min(text.find('\n'), text.size());
        std::string_view line = trimmed(text.substr(0, end));
        text.remove_prefix(std::min(end + 1, text.size()));
        std::size_t equals = line.find('=');
        if (line.empty() || line.front() == '#' || equals == std::string_view::npos) continue;
        table.emplace(trimmed(line.substr(0, equals)), withLineBreaks(trimmed(line.substr(equals + 1))));
    }
    return table;
}

std::vector<std::string> stringTableNames() {
    std::vector<std::string> names;
    for (const StringTableSource& source : kStringTableSources) names.emplace_back(source.name);
    names.emplace_back(kKeysTableName);
    return names;
}

std::optional<StringTable> stringTable(std::string_view name) {
    if (name == kKeysTableName) return keysTable();
    for (const StringTableSource& source : kStringTableSources)
        if (name == source.name) return parseStringTable(source.text);
    return std::nullopt;
}

StringTable reportTable(std::string_view name) {
    for (const StringTableSource& source : kReportTableSources)
        if (name == source.name) return parseStringTable(source.text);
    return parseStringTable(kReportTableSources[0].text);
}

}  // namespace wp::host
