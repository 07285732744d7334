#pragma once

#include <memory>
#include <string_view>

#include "platform/capabilities.h"
#include "platform/diagnostic.h"
#include "platform/diagnostics.h"
#include "platform/localization.h"
#include "platform/log.h"
#include "platform/queue.h"
#include "platform/test_automation.h"
#include "platform/wifi_manager.h"

/// What only the program's own modules see of one another; everything else is built with hidden visibility.
#define WP_EXPORT __attribute__((visibility("default")))

namespace wp {

namespace ui {
class Screen;
}

/// Changes with every change of this folder's headers that an extension built before it could not live with.
inline constexpr int kExtensionInterfaceVersion = 1;

/// The exported name of an extension's entry.
inline constexpr const char* kExtensionEntryName = "wifiProfileExtensionEntry";

/// All that a diagnostic sees of its device and host. The host owns it and keeps it alive until every queue
/// is drained.
struct Platform {
    DiagnosticsClient& diagnosticsClient;
    WiFiManagerService& wifiManager;
    CapabilityQuery& capabilities;
    TestAutomation& testAutomation;
    Queue& mainQueue;
    Queue& backgroundQueue;
    Log& log;
    Localization& localization;
    ui::Screen& screen;
};

/// What an extension makes for one run.
struct ExtensionObjects {
    std::shared_ptr<DiagnosticInputs> inputs;
    std::shared_ptr<DiagnosticViewController> controller;
};

/// What the host hands to an extension's entry, and gets back from it. *Main*.
struct ExtensionContext {
    Platform& platform;
    ExtensionObjects objects;  ///< filled by the extension main routine
};

/// The signature of the exported entry: the command line's arguments and the host's context. Returns 0 when
/// the context's objects are there.
using ExtensionEntry = int(int argc, const char* const* argv, ExtensionContext* context);

/// How an extension says what it is made of: one static object of this type in its module. Its construction,
/// while the host loads the module, tells the extension main routine which objects to make.
class ExtensionRegistration {
  public:
    using Factory = ExtensionObjects (*)(Platform&);

    /// The version defaults to the one that the extension is compiled with.
    explicit ExtensionRegistration(Factory factory, int interfaceVersion = kExtensionInterfaceVersion);
};

/// The interface version of the extension that was loaded last; 0 before one registered. *Main*.
int registeredExtensionVersion();

/// The extension main routine: makes the registered extension's inputs and controller for the context's
/// platform. Returns 0, or 1 when no extension is registered or the context is null. *Main*.
int extensionMain(int argc, const char* const* argv, ExtensionContext* context);

}  // namespace wp
