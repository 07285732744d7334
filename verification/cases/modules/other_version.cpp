// A diagnostic that was built for a later version of the interface.
#include "platform/extension.h"

static const wp::ExtensionRegistration kRegistration([](wp::Platform&) { return wp::ExtensionObjects{}; },
                                                     wp::kExtensionInterfaceVersion + 1);

extern "C" WP_EXPORT int wifiProfileExtensionEntry(int argc, const char* const* argv,
                                                   wp::ExtensionContext* context) {
    return wp::extensionMain(argc, argv, context);
}
