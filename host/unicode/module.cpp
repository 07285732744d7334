#include "host/unicode/icu_functions.h"
#include "host/unicode/unicode_module.h"

// The module's entry: all that the program sees of it.
extern "C" __attribute__((visibility("default"))) const wp::host::UnicodeModule* wifiProfileUnicode() {
    namespace icu_functions = wp::host::icu_functions;
    static constexpr wp::host::UnicodeModule module = {icu_functions::nameOrder, icu_functions::columnsOf,
                                                       icu_functions::wrappedLines,
                                                       icu_functions::withUnitsKept};
    return &module;
}
