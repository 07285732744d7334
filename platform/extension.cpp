#include "platform/extension.h"

namespace wp {
namespace {

struct Registered {
    ExtensionRegistration::Factory factory = nullptr;
    int interfaceVersion = 0;
};

Registered& registered() {
    static Registered instance;
    return instance;
}

}  // namespace

ExtensionRegistration::ExtensionRegistration(Factory factory, int interfaceVersion) {
    registered() = {factory, interfaceVersion};
}

int registeredExtensionVersion() {
    return registered().interfaceVersion;
}

int extensionMain(int, const char* const*, ExtensionContext* context) {
    if (!context || !registered().factory) return 1;
    context->objects = registered().factory(context->platform);
    return 0;
}

}  // namespace wp
