#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace wp::host {

/// The columns that the text takes on a terminal: two for a wide character, none for a mark. *Any*.
int columnsOf(std::string_view text);

/// Lines of at most that many columns, broken where the language allows it (ICU's rules), a too long word
/// anywhere. Blanks at the ends of lines are left out; an empty text gives no line. *Any*.
std::vector<std::string> wrappedLines(std::string_view text, int columns);

/// The text with no-break blanks between numbers and their units, for what is broken into lines elsewhere. *Any*.
std::string withUnitsKept(std::string_view text);

}  // namespace wp::host
