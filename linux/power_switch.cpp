#include "linux/power_switch.h"

#include <fcntl.h>
#include <linux/rfkill.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <fstream>

namespace wp {
namespace {

constexpr const char* kDevice = "/dev/rfkill";
constexpr std::size_t kOldestEventSize = 8;

std::string firstLine(const std::string& path) {
    std::ifstream file(path);
    std::string line;
    std::getline(file, line);
    return line;
}

std::string switchName(std::uint32_t index) {
    return firstLine("/sys/class/rfkill/rfkill" + std::to_string(index) + "/name");
}

std::optional<std::uint32_t> numberOfRadio(const std::string& name) {
    const std::string text = firstLine("/sys/class/ieee80211/" + name + "/index");
    if (text.empty() || text.size() > 9 || text.find_first_not_of("0123456789") != std::string::npos)
        return std::nullopt;
    return static_cast<std::uint32_t>(std::stoul(text));
}

Descriptor openedDevice() {
    Descriptor device(open(kDevice, O_RDWR | O_CLOEXEC | O_NONBLOCK));
    return device ? std::move(device) : Descriptor(open(kDevice, O_RDONLY | O_CLOEXEC | O_NONBLOCK));
}

}  // namespace

std::optional<SwitchEvent> readSwitchEvent(Bytes bytes) {
    rfkill_event event;
    static_assert(sizeof event == kOldestEventSize);
    if (bytes.size() < sizeof event) return std::nullopt;
    std::memcpy(&event, bytes.data(), sizeof event);
    return SwitchEvent{event.idx,
                       event.op == RFKILL_OP_DEL ? SwitchEvent::Kind::removed : SwitchEvent::Kind::present,
                       event.type == RFKILL_TYPE_WLAN, event.soft != 0 || event.hard != 0, event.hard != 0};
}

PowerSwitch::PowerSwitch() : PowerSwitch(openedDevice()) {}

PowerSwitch::PowerSwitch(Descriptor device)
    : device_(std::move(device)),
      writable_(device_ && (::fcntl(device_.number(), F_GETFL) & O_ACCMODE) == O_RDWR) {
    update();
}

void PowerSwitch::update() {
    std::array<std::uint8_t, 64> bytes;
    for (;;) {
        const ssize_t size = device_ ? read(device_.number(), bytes.data(), bytes.size()) : -1;
        if (size <= 0) return;
        const auto event = readSwitchEvent({bytes.data(), static_cast<std::size_t>(size)});
        if (!event || !event->isWiFi) continue;
        if (event->kind == SwitchEvent::Kind::removed) {
            switches_.erase(event->index);
            continue;
        }
        const auto [place, isNew] = switches_.try_emplace(event->index);
        place->second.blocked = event->blocked;
        place->second.byHardware = event->byHardware;
        if (!isNew) continue;
        // A radio's own switch has the radio's name, "phy0"; other switches are the machine's.
        const std::string name = switchName(event->index);
        place->second.radio = numberOfRadio(name);
        place->second.elsewhere = !place->second.radio && name.starts_with("phy");
    }
}

bool PowerSwitch::isOn(std::uint32_t radio) const {
    return std::ranges::none_of(switches_, [radio](const auto& entry) {
        return entry.second.blocked && entry.second.concerns(radio);
    });
}

bool PowerSwitch::isHeldOff(std::optional<std::uint32_t> radio) const {
    return std::ranges::any_of(switches_, [radio](const auto& entry) {
        return entry.second.byHardware && entry.second.concerns(radio);
    });
}

std::optional<Error> PowerSwitch::set(bool on) {
    if (!device_) return failure(Reason::unavailable, std::string(kDevice) + " cannot be opened");
    if (!writable_) return failure(Reason::notPermitted, std::string("no permission to write to ") + kDevice);
    rfkill_event event{};
    event.op = RFKILL_OP_CHANGE_ALL;
    event.type = RFKILL_TYPE_WLAN;
    event.soft = on ? 0 : 1;
    if (write(device_.number(), &event, sizeof event) < 0) {
        return failure(Reason::unavailable, std::string("Wi-Fi power: ") + std::strerror(errno));
    }
    return std::nullopt;
}

}  // namespace wp
