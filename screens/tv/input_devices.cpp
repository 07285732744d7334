#include "screens/tv/input_devices.h"

#include <fcntl.h>
#include <linux/input.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <filesystem>

namespace wp::tv {
namespace {

/// There while a device manager runs.
constexpr const char* kDeviceManager = "/run/udev/control";
constexpr const char* kDevicesVariable = "QT_QPA_EVDEV_KEYBOARD_PARAMETERS";

}  // namespace

std::vector<std::string> inputDevices() {
    std::vector<std::string> found;
    std::error_code error;
    for (const auto& entry : std::filesystem::directory_iterator("/dev/input", error))
        if (entry.path().filename().string().starts_with("event") && access(entry.path().c_str(), R_OK) == 0)
            found.push_back(entry.path());
    std::ranges::sort(found);
    return found;
}

void nameDevicesToToolkit() {
    if (access(kDeviceManager, F_OK) == 0 || qEnvironmentVariableIsSet(kDevicesVariable)) return;
    std::string joined;
    for (const std::string& device : inputDevices()) joined += (joined.empty() ? "" : ":") + device;
    if (joined.empty()) return;
    qputenv(kDevicesVariable, QByteArray::fromStdString(joined));
    qputenv("QT_QPA_FB_NO_LIBINPUT", "1");
    qputenv("QT_QPA_EGLFS_NO_LIBINPUT", "1");
}

bool readsDevicesItself(const std::string& platform) {
    if (platform.starts_with("linuxfb")) return qEnvironmentVariableIntValue("QT_QPA_FB_NO_LIBINPUT") != 0;
    return platform.starts_with("eglfs") && qEnvironmentVariableIntValue("QT_QPA_EGLFS_NO_LIBINPUT") != 0;
}

DroppedKeys::DroppedKeys(const std::vector<std::string>& devices, Press press) : press_(std::move(press)) {
    for (const std::string& path : devices) {
        auto device = std::make_unique<Device>();
        device->file = std::make_unique<QFile>(QString::fromStdString(path));
        if (!device->file->open(QIODevice::ReadOnly | QIODevice::Unbuffered)) continue;
        int number = device->file->handle();
        fcntl(number, F_SETFL, fcntl(number, F_GETFL) | O_NONBLOCK);
        device->notifier = std::make_unique<QSocketNotifier>(number, QSocketNotifier::Read);
        QObject::connect(device->notifier.get(), &QSocketNotifier::activated,
                         [this, given = device.get()] { read(*given); });
        devices_.push_back(std::move(device));
    }
}

void DroppedKeys::read(Device& device) {
    std::array<input_event, 16> events;
    ssize_t size = ::read(device.file->handle(), events.data(), sizeof events);
    if (size <= 0) {
        // Pulled out.
        if (size == 0 || errno != EAGAIN) device.notifier->setEnabled(false);
        return;
    }
    for (std::size_t i = 0; i < static_cast<std::size_t>(size) / sizeof(input_event); ++i) {
        if (events[i].type != EV_KEY || events[i].value != 1) continue;
        if (events[i].code == KEY_OK) press_(ui::Key::select);
        if (events[i].code == KEY_BACK) press_(ui::Key::back);
    }
}

}  // namespace wp::tv
