#include "host/modules/module_entry.h"

#include <dlfcn.h>

namespace wp::host {
namespace {

ModuleFault fault(ModuleFault::Kind kind, const std::filesystem::path& file) {
    const char* const reason = dlerror();
    return {kind, reason ? reason : file.string()};
}

}  // namespace

std::filesystem::path programFolder() {
    std::error_code error;
    return std::filesystem::read_symlink("/proc/self/exe", error).parent_path();
}

std::string ModuleFault::text() const {
    return "a part of the program is missing or broken: " + reason;
}

std::variant<void*, ModuleFault> moduleEntry(const std::filesystem::path& file, const char* entryName) {
    using Kind = ModuleFault::Kind;
    void* const handle = dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE);
    std::error_code error;
    if (!handle) return fault(std::filesystem::exists(file, error) ? Kind::notLoadable : Kind::absent, file);
    void* const entry = dlsym(handle, entryName);
    if (!entry) return fault(Kind::withoutEntry, file);
    return entry;
}

}  // namespace wp::host
