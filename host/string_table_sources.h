#pragma once

#include <array>

namespace wp::host {

/// One file of `resources/strings/`, compiled in so that the program never runs without its texts.
struct StringTableSource {
    const char* name;
    const char* text;
};

/// Texts of the screens, and of the report and the catalogue; the default language first.
extern const std::array<StringTableSource, 3> kStringTableSources;
extern const std::array<StringTableSource, 3> kReportTableSources;

}  // namespace wp::host
