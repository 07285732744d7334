#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/queue.h"

namespace wp {

/// A handle to one Wi-Fi device of a manager client; releasing the last reference releases the device.
class WiFiDeviceClient {
  public:
    virtual ~WiFiDeviceClient() = default;

    virtual std::string interfaceName() const = 0;

    /// Registers what is called after each change of Wi-Fi power, on the queue on which the device's client
    /// was scheduled. An empty callback unregisters; once that has returned, no further call begins. *Any*
    /// thread.
    virtual void registerPowerCallback(std::function<void()> callback) = 0;
};

/// A handle to the Wi-Fi manager; releasing the last reference releases the client. *Any* thread.
class WiFiManagerClient {
  public:
    virtual ~WiFiManagerClient() = default;

    /// Lets the client's callbacks be delivered on this run loop, in its default mode.
    virtual void scheduleWithRunLoop(Queue& runLoop) = 0;
    virtual void setType(int type) = 0;
    virtual std::vector<std::shared_ptr<WiFiDeviceClient>> copyDevices() = 0;
    /// Non-zero: Wi-Fi is on.
    virtual int power() = 0;
    /// 1 turns Wi-Fi on, 0 off. Returns at once; the power callback tells of the change.
    virtual void setPower(int power) = 0;
};

/// The Wi-Fi manager service of the device. *Any* thread.
class WiFiManagerService {
  public:
    virtual ~WiFiManagerService() = default;

    virtual bool hasRadio() = 0;
    /// A new client of the given type; null when none can be had.
    virtual std::shared_ptr<WiFiManagerClient> createClient(int type) = 0;
};

}  // namespace wp
