#include "host/extension_module.h"

#include <dlfcn.h>

#include "host/exit.h"
#include "host/modules/module_entry.h"

namespace wp::host {
namespace {

std::string loaderReason() {
    const char* reason = dlerror();
    return reason ? reason : "no reason given";
}

}  // namespace

ExtensionModule::ExtensionModule(const std::optional<std::string>& path)
    : path_(path ? std::filesystem::path(*path) : programFolder() / kExtensionFileName) {
    std::string name = "--extension: " + path_.string();
    std::error_code error;
    if (!std::filesystem::exists(path_, error))
        refuse(name + ": not found; give the path of the diagnostic's module");
    // With a folder before it, the loader takes the name for a file and searches nowhere else.
    void* handle = dlopen(std::filesystem::absolute(path_).c_str(), RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE);
    if (!handle) refuse(name + ": cannot be loaded: " + loaderReason());
    entry_ = reinterpret_cast<ExtensionEntry*>(dlsym(handle, kExtensionEntryName));
    if (!entry_) refuse(name + ": lacks the entry " + kExtensionEntryName + "; it is no diagnostic");
    int version = registeredExtensionVersion();
    if (version == 0) refuse(name + ": registers no diagnostic");
    if (version != kExtensionInterfaceVersion)
        refuse(name + ": built for version " + std::to_string(version) +
               " of the interface; this program has version " + std::to_string(kExtensionInterfaceVersion));
}

ExtensionObjects ExtensionModule::makeObjects(Platform& platform) const {
    ExtensionContext context{platform, {}};
    std::string program = "wifi-profile";
    const char* argv[] = {program.c_str(), nullptr};
    if (entry_(1, argv, &context) != 0 || !context.objects.inputs || !context.objects.controller)
        refuse("--extension: " + path_.string() + ": makes no diagnostic");
    return std::move(context.objects);
}

}  // namespace wp::host
