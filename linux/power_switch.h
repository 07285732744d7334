#pragma once

#include <map>
#include <optional>
#include <string>
#include <vector>

#include "exchange/descriptor.h"
#include "service/bytes.h"
#include "service/known.h"

namespace wp {

/// One word of the kernel on a switch of a radio.
struct SwitchEvent {
    enum class Kind { present, removed };
    std::uint32_t index = 0;
    Kind kind = Kind::present;
    bool isWiFi = false;
    bool blocked = false;     ///< by software or by hardware
    bool byHardware = false;  ///< so that no software can lift it
};

/// Reads one event as the kernel hands it over, of this or a later form. A pure function; *any* thread.
std::optional<SwitchEvent> readSwitchEvent(Bytes bytes);

/// The Wi-Fi power of this machine. Opened while the program still has its privileges. Owner's thread.
class PowerSwitch {
  public:
    PowerSwitch();
    /// Over a device that is open for reading, and for writing where that is permitted.
    explicit PowerSwitch(Descriptor device);

    /// Readable when a switch has changed; -1 where there are none.
    int descriptor() const { return device_.number(); }
    /// Takes in what has changed.
    void update();

    /// Whether the radio may send. A radio without any switch is on.
    bool isOn(std::uint32_t radio) const;
    /// Whether a switch of hardware keeps the radio off, or, without a radio, all of them.
    bool isHeldOff(std::optional<std::uint32_t> radio) const;
    /// Switches all Wi-Fi radios; nothing, or why that is not possible.
    std::optional<Error> set(bool on);

  private:
    struct Switch {
        bool blocked = false;
        bool byHardware = false;
        std::optional<std::uint32_t> radio;  ///< absent: a switch of the machine, for all radios
        bool elsewhere = false;              ///< of a radio that this program cannot see
        bool concerns(std::optional<std::uint32_t> which) const {
            return !elsewhere && (!radio || radio == which);
        }
    };

    Descriptor device_;
    bool writable_ = false;
    std::map<std::uint32_t, Switch> switches_;
};

}  // namespace wp
