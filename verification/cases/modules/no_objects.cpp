// A diagnostic that makes neither inputs nor controller.
#include "platform/extension.h"

static const wp::ExtensionRegistration kRegistration([](wp::Platform&) { return wp::ExtensionObjects{}; });

extern "C" WP_EXPORT int wifiProfileExtensionEntry(int argc, const char* const* argv,
                                                   wp::ExtensionContext* context) {
    return wp::extensionMain(argc, argv, context);
}
