#include "host/unicode/unicode.h"

#include <stdexcept>

#include "host/modules/module_entry.h"
#include "host/unicode/unicode_module.h"

namespace wp::host {
namespace {

const UnicodeModule& loadedModule() {
    static const UnicodeModule* const module = [] {
        const auto entry = moduleEntry(programFolder() / kUnicodeModuleFileName, kUnicodeEntryName);
        if (const ModuleFault* fault = std::get_if<ModuleFault>(&entry))
            throw std::runtime_error(fault->text());
        return reinterpret_cast<UnicodeEntry*>(std::get<void*>(entry))();
    }();
    return *module;
}

}  // namespace

void needUnicode() {
    loadedModule();
}

NameOrder nameOrder(const std::string& locale) {
    return loadedModule().nameOrder(locale);
}

int columnsOf(std::string_view text) {
    return loadedModule().columnsOf(text);
}

std::vector<std::string> wrappedLines(std::string_view text, int columns) {
    return loadedModule().wrappedLines(text, columns);
}

std::string withUnitsKept(std::string_view text) {
    return loadedModule().withUnitsKept(text);
}

}  // namespace wp::host
