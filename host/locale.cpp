#include "host/locale.h"

#include <algorithm>
#include <cstdlib>

#include "host/string_table.h"

namespace wp::host {
namespace {

/// The name without its character set and modifier: "de_AT.UTF-8@euro" is "de_AT".
std::string_view withoutCodeset(std::string_view name) {
    return name.substr(0, name.find_first_of(".@"));
}

std::string languageOf(std::string_view name) {
    std::string language(name.substr(0, name.find_first_of("_-")));
    for (char& letter : language)
        if (letter >= 'A' && letter <= 'Z') letter = static_cast<char>(letter - 'A' + 'a');
    return language;
}

bool hasTable(const std::string& name) {
    std::vector<std::string> names = stringTableNames();
    return std::find(names.begin(), names.end(), name) != names.end();
}

std::string firstSet(std::initializer_list<const char*> variables) {
    for (const char* variable : variables) {
        const char* value = std::getenv(variable);
        if (value && *value) return value;
    }
    return "";
}

std::string collationOf(std::string_view name) {
    std::string collation(withoutCodeset(name));
    return collation == "C" || collation == "POSIX" ? "" : collation;
}

}  // namespace

std::optional<LocaleChoice> localeNamed(std::string_view name) {
    if (name == kKeysTableName) return LocaleChoice{kKeysTableName, ""};
    std::string_view plain = withoutCodeset(name);
    std::string language = languageOf(plain);
    if (!hasTable(language)) return std::nullopt;
    return LocaleChoice{language, std::string(plain)};
}

LocaleChoice localeOfEnvironment() {
    std::string messages = firstSet({"LC_ALL", "LC_MESSAGES", "LANG"});
    std::string collation = firstSet({"LC_ALL", "LC_COLLATE", "LANG"});
    std::optional<LocaleChoice> choice = localeNamed(messages);
    return {choice ? choice->stringTable : stringTableNames().front(), collationOf(collation)};
}

}  // namespace wp::host
