#include "lifecycle/wifi_profile_view_controller.h"
#include "platform/ui/alert_controller.h"

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
    // Here and below: what the controller itself keeps must not keep the controller alive.
    devices.front()->registerPowerCallback([weakSelf = weakSelf()] {
        if (auto self = weakSelf.lock()) self->powerChanged();
    });
    return true;
}

void WiFiProfileViewController::presentWiFiPoweredOffAlert() {
    const Localization& strings = platform_.localization;
    bool isWLAN = platform_.capabilities.booleanAnswer("wapi");
    auto alert = std::make_shared<ui::AlertController>(
        std::nullopt, strings.localizedString(isWLAN ? "POWER_ON_WLAN" : "POWER_ON_WIFI"),
        ui::AlertController::Style::alert);
    alert->addAction(std::make_shared<ui::AlertAction>(strings.localizedString("NO"),
                                                       ui::AlertAction::Style::standard,
                                                       [weakSelf = weakSelf()](ui::AlertAction&) {
                                                           if (auto self = weakSelf.lock())
                                                               self->endTestWithStatusCode(kPowerDeclined);
                                                       }));
    alert->addAction(std::make_shared<ui::AlertAction>(
        strings.localizedString("YES"), ui::AlertAction::Style::standard,
        [weakSelf = weakSelf()](ui::AlertAction&) {
            auto self = weakSelf.lock();
            std::shared_ptr<WiFiManagerClient> manager = self ? self->manager_.get() : nullptr;
            // The power callback tells when Wi-Fi is on, and the run goes on from there.
            if (manager) manager->setPower(kPowerOn);
        }));
    presentAlert(std::move(alert), ui::Animated::yes);
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
