#include <memory>

#include "lifecycle/wifi_profile_inputs.h"
#include "lifecycle/wifi_profile_view_controller.h"
#include "platform/extension.h"

namespace wp {
namespace {

ExtensionObjects makeObjects(Platform& platform) {
    return {std::make_shared<WiFiProfileInputs>(), std::make_shared<WiFiProfileViewController>(platform)};
}

const ExtensionRegistration registration(&makeObjects);

}  // namespace
}  // namespace wp

extern "C" WP_EXPORT int wifiProfileExtensionEntry(int argc, const char* const* argv,
                                                   wp::ExtensionContext* context);

int wifiProfileExtensionEntry(int argc, const char* const* argv, wp::ExtensionContext* context) {
    return wp::extensionMain(argc, argv, context);
}
