#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <vector>

// What the program knows of writing beyond bytes. The library behind it (ICU) is a fifth of the program's memory, and a
// run without the list that hands over its document never needs it: it is in a module of its own, which the first of
// these calls loads. Each throws `std::runtime_error` with one line where the module cannot be had. *Any* thread.

namespace wp::host {

/// Loads the module, for whoever wants to know early whether it can be had.
void needUnicode();

/// Gives each name the bytes that sort as the names do: case is ignored, accents count, and so do blanks and
/// punctuation. *Any* thread.
using NameOrder = std::function<std::string(std::string_view name)>;

/// The order of an ICU locale, "" for the root's. Without the library's data names still have one fixed order.
NameOrder nameOrder(const std::string& locale);

/// The columns that the text takes on a terminal: two for a wide character, none for a mark.
int columnsOf(std::string_view text);

/// Lines of at most that many columns, broken where the language allows it (ICU's rules), a too long word
/// anywhere. Blanks at the ends of lines are left out; an empty text gives no line.
std::vector<std::string> wrappedLines(std::string_view text, int columns);

/// The text with no-break blanks between numbers and their units, for what is broken into lines elsewhere.
std::string withUnitsKept(std::string_view text);

}  // namespace wp::host
