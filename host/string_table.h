#pragma once

#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace wp::host {

/// The texts of one language by their localization keys.
using StringTable = std::map<std::string, std::string, std::less<>>;

/// The name of the table in which every text is its own key, for testers and for scripts.
inline constexpr const char* kKeysTableName = "x-keys";

/// A table from the text of a `.strings` file: "KEY = text" a line, "#" begins a comment line, "\n" in a text
/// is a line break. Lines of another form are left out. *Any*.
StringTable parseStringTable(std::string_view text);

/// The names of all tables, the default first. *Any*.
std::vector<std::string> stringTableNames();

/// The table of that name (`en`, `de`, `ja`, `x-keys`); nothing for a name that no table has. *Any*.
std::optional<StringTable> stringTable(std::string_view name);

/// The texts of reports in the table of that name. The table `x-keys` holds the default language's, for their
/// places. *Any*.
StringTable reportTable(std::string_view name);

}  // namespace wp::host
