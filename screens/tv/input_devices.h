#pragma once

#include <QFile>
#include <QSocketNotifier>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/ui/screen.h"

namespace wp::tv {

/// The kernel's input devices that this process may read.
std::vector<std::string> inputDevices();

/// Without a desktop and without a device manager, whose word on devices the toolkit waits for, names all input
/// devices to it; what the environment says already is left as it is. Before the application. *Main*.
void nameDevicesToToolkit();

/// Whether the toolkit on this platform reads input devices by itself and not through libinput.
bool readsDevicesItself(const std::string& platform);

/// The keys of remote controls that the toolkit's own reader of input devices drops: `KEY_OK` and `KEY_BACK`,
/// read beside it. Devices that come later are not seen. *Main*.
class DroppedKeys {
  public:
    using Press = std::function<void(ui::Key)>;

    DroppedKeys(const std::vector<std::string>& devices, Press press);

  private:
    struct Device {
        std::unique_ptr<QFile> file;
        std::unique_ptr<QSocketNotifier> notifier;
    };

    void read(Device& device);

    Press press_;
    std::vector<std::unique_ptr<Device>> devices_;
};

}  // namespace wp::tv
