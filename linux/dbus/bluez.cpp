#include "linux/dbus/bluez.h"

#include <filesystem>

namespace wp {
namespace {

const std::string kService = "org.bluez";

}  // namespace

Bluetooth bluetoothFrom(const BusValue& objects) {
    Bluetooth bluetooth;
    for (const auto& entry : objects.map()) {
        const BusValue& adapter = entry.second[kService + ".Adapter1"];
        const BusValue& device = entry.second[kService + ".Device1"];
        if (!adapter.empty()) ++bluetooth.controllers;
        bluetooth.powered |= adapter["Powered"].flag();
        if (device["Paired"].flag()) ++bluetooth.paired;
        if (device["Connected"].flag()) ++bluetooth.connected;
    }
    return bluetooth;
}

Known<Bluetooth> readBluetooth(Known<Bus>& bus, bool controllerExists, const Until& until) {
    Known<BusValue> objects = bus ? bus->managedObjects({kService, "/"}, until) : bus.error();
    if (objects) return bluetoothFrom(*objects);
    const bool cancelled = objects.error().code == static_cast<int>(Reason::cancelled);
    if (!controllerExists && !cancelled) return Bluetooth{};
    return objects.error();
}

bool bluetoothControllerExists(const std::string& folder) {
    std::error_code failed;
    for (const auto& entry : std::filesystem::directory_iterator(folder, failed)) {
        // Connections of a controller stand beside it as "hci0:64".
        const std::string name = entry.path().filename().string();
        if (name.starts_with("hci") && name.find(':') == name.npos) return true;
    }
    return false;
}

}  // namespace wp
