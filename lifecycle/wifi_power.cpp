#include "lifecycle/wifi_profile_view_controller.h"

namespace wp {
namespace {

constexpr int kLogCategory = 0;
constexpr int kManagerType = 0;
constexpr int kPowerOn = 1;

constexpr int kNoManager = -2;
constexpr int kNoDevice = -3;
constexpr int kPowerDeclined = -4;
constexpr int kPowerOff = -5;

}  // namespace

bool WiFiProfileViewController::setupWiFi() {
    bool hasDevice = false;
    platform_.backgroundQueue.sync([&] {
        std::shared_ptr<WiFiManagerClient> manager;
        if (platform_.wifiManager.hasRadio()) manager = platform_.wifiManager.createClient(kManagerType);
        if (!manager) {
            logWiFiManagerError("WiFiManagerClientCreate failed - unable to get Wi-Fi manager handle.");
            endTestWithStatusCode(kNoManager);
            return;
        }
        manager_.set(manager);
        hasDevice = obtainDevice(*manager);
    });
    return hasDevice;
}

bool WiFiProfileViewController::obtainDevice(WiFiManagerClient& manager) {
    // A thread without a run loop gets its callbacks where they belong in any case.
    Queue* runLoop = Queue::current();
    manager.scheduleWithRunLoop(runLoop ? *runLoop : platform_.mainQueue);
    manager.setType(kManagerType);
    std::vector<std::shared_ptr<WiFiDeviceClient>> devices = manager.copyDevices();
    if (devices.empty()) {
        logWiFiManagerError("[ERROR] - Couldn't find a Wi-Fi device.");
        manager_.set(nullptr);
        endTestWithStatusCode(kNoDevice);
        return false;
    }
    device_.set(devices.front());
    wifiPoweredOn_ = manager.power() != 0;
    // The device must not keep the controller alive: the controller keeps the device.
    devices.front()->registerPowerCallback([weakSelf = weak_from_this()] {
        if (auto strongSelf = weakSelf.lock())
            static_cast<WiFiProfileViewController&>(*strongSelf).powerChanged();
    });
    return true;
}

void WiFiProfileViewController::powerChanged() {
    std::shared_ptr<WiFiManagerClient> manager = manager_.get();
    if (!manager || ended_) return;
    wifiPoweredOn_ = manager->power() != 0;
    if (wifiPoweredOn_) {
        showSpinner();
        displayNetworkList();
    } else {
        endTestWithStatusCode(kPowerOff);
    }
}

void WiFiProfileViewController::logWiFiManagerError(std::string_view message) const {
    if (platform_.log.isErrorEnabled(kLogCategory)) platform_.log.error(kLogCategory, message);
}

}  // namespace wp
