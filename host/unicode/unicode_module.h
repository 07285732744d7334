#pragma once

#include "host/unicode/unicode.h"

namespace wp::host {

inline constexpr const char* kUnicodeModuleFileName = "wifi-profile-unicode.so";
inline constexpr const char* kUnicodeEntryName = "wifiProfileUnicode";

/// What the module does, as `unicode.h` says it. Program and module are of one build.
struct UnicodeModule {
    NameOrder (*nameOrder)(const std::string& locale);
    int (*columnsOf)(std::string_view text);
    std::vector<std::string> (*wrappedLines)(std::string_view text, int columns);
    std::string (*withUnitsKept)(std::string_view text);
};

/// The module's entry. *Any* thread.
using UnicodeEntry = const UnicodeModule*();

}  // namespace wp::host
