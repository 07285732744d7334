#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/queue.h"
#include "platform/wifi_manager.h"

namespace wp {

/// What the handles of one Wi-Fi manager stand for: the one radio behind all of them. *Any* thread.
class WiFiRadio {
  public:
    virtual ~WiFiRadio() = default;

    virtual std::vector<std::string> devices() = 0;
    virtual bool power() = 0;
    virtual void setPower(bool power) = 0;
    /// Where callbacks are delivered from now on.
    virtual void setRunLoop(Queue& runLoop) = 0;
    /// Registers the callback for this device handle; an empty one unregisters.
    virtual void setCallback(const void* device, std::function<void()> callback) = 0;
};

/// A manager client whose devices are the radio's; a device that is released is unregistered. *Any* thread.
std::shared_ptr<WiFiManagerClient> makeWiFiManagerClient(std::shared_ptr<WiFiRadio> radio);

}  // namespace wp
