#pragma once

#include "host/unicode/unicode.h"

/// The functions of `unicode.h` inside the module, by ICU.
namespace wp::host::icu_functions {

NameOrder nameOrder(const std::string& locale);
int columnsOf(std::string_view text);
std::vector<std::string> wrappedLines(std::string_view text, int columns);
std::string withUnitsKept(std::string_view text);

}  // namespace wp::host::icu_functions
