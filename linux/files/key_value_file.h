#pragma once

#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace wp {

/// The whole content of a small file, at most `longest` bytes; nothing where it cannot be read or is longer.
/// *Any* thread.
std::optional<std::string> readSmallFile(const std::string& path, std::size_t longest = 256U << 10);

/// The lines of a text without their ends.
std::vector<std::string_view> linesOf(std::string_view text);
/// The words of a text, which blanks separate.
std::vector<std::string> wordsOf(std::string_view text);
/// Without blanks at both ends.
std::string_view trimmed(std::string_view text);

/// A line without its comment, which begins with '#' at the line's start or behind a blank, but not between double quotes.
std::string_view uncommented(std::string_view line);

/// "KEY=VALUE" lines as service managers and shells write them: a comment begins with '#', a value may stand in
/// quotes, `export ` before a key is dropped. A later line wins. *Any* thread.
std::map<std::string, std::string> readAssignments(std::string_view text);

/// The settings of a unit file: section, then key, then the values in their order; an empty value clears those
/// before it. A line that ends in a backslash goes on with the next that is no comment. *Any* thread.
using UnitFile = std::map<std::string, std::map<std::string, std::vector<std::string>>>;
void readUnitFile(std::string_view text, UnitFile& into);

}  // namespace wp
