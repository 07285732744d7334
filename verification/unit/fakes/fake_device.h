#pragma once

#include "platform/background_queue.h"
#include "platform/extension.h"
#include "platform/main_queue.h"
#include "platform/ui/screen.h"
#include "verification/unit/fakes/fake_diagnostics_client.h"
#include "verification/unit/fakes/fake_host.h"
#include "verification/unit/fakes/fake_wifi_manager.h"
#include "verification/unit/fakes/recording_log.h"
#include "verification/unit/fakes/stepped_queues.h"

namespace wp::fakes {

/// All of a device and its host but the queues.
struct FakeServices {
    FakeDiagnosticsClient service;
    FakeWiFiManager wifi;
    FakeCapabilities capabilities;
    FakeTestAutomation automation;
    RecordingLog log;
    FakeLocalization localization;
};

/// A device on which the test takes every step itself.
struct FakeDevice : FakeServices {
    SteppedQueues queues;
    ui::Screen screen;
    Platform platform{service, wifi,         capabilities, automation, queues.main(), queues.background(),
                      log,     localization, screen};
};

/// A device with real threads, for what must hold whatever their order. The test's thread is the main thread.
struct ThreadedDevice : FakeServices {
    Activity activity;
    MainQueue main{activity};
    ui::Screen screen;
    BackgroundQueue background{activity};
    Platform platform{service, wifi, capabilities, automation, main, background, log, localization, screen};
};

}  // namespace wp::fakes
