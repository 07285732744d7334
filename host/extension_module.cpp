#include "host/extension_module.h"

#include "host/exit.h"
#include "host/modules/module_entry.h"

namespace wp::host {
namespace {

std::string described(const ModuleFault& fault) {
    switch (fault.kind) {
        case ModuleFault::Kind::absent:
            return "not found; give the path of the diagnostic's module";
        case ModuleFault::Kind::notLoadable:
            return "cannot be loaded: " + fault.reason;
        default:
            return std::string("lacks the entry ") + kExtensionEntryName + "; it is no diagnostic";
    }
}

}  // namespace

ExtensionModule::ExtensionModule(const std::optional<std::string>& path)
    : path_(path ? std::filesystem::path(*path) : programFolder() / kExtensionFileName) {
    std::string name = "--extension: " + path_.string();
    const auto entry = moduleEntry(std::filesystem::absolute(path_), kExtensionEntryName);
    if (const ModuleFault* fault = std::get_if<ModuleFault>(&entry)) refuse(name + ": " + described(*fault));
    entry_ = reinterpret_cast<ExtensionEntry*>(std::get<void*>(entry));
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
