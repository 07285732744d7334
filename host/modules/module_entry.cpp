#include "host/modules/module_entry.h"

#include <dlfcn.h>

namespace wp::host {

std::filesystem::path programFolder() {
    std::error_code error;
    return std::filesystem::read_symlink("/proc/self/exe", error).parent_path();
}

std::variant<void*, std::string> moduleEntry(const char* fileName, const char* entryName) {
    const std::string file = (programFolder() / fileName).string();
    void* const handle = dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE);
    void* const entry = handle ? dlsym(handle, entryName) : nullptr;
    if (entry) return entry;
    const char* const reason = dlerror();
    return "a part of the program is missing or broken: " + std::string(reason ? reason : file.c_str());
}

}  // namespace wp::host
