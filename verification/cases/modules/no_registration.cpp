// The entry alone: nothing says what the module is made of.
#include "platform/extension.h"

extern "C" WP_EXPORT int wifiProfileExtensionEntry(int argc, const char* const* argv,
                                                   wp::ExtensionContext* context) {
    return wp::extensionMain(argc, argv, context);
}
