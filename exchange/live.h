#pragma once

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string_view>

#include "exchange/service_process.h"
#include "platform/diagnostics.h"
#include "platform/error.h"
#include "platform/wifi_manager.h"

namespace wp {

struct LiveServiceOptions {
    /// Above what the service itself allows a test, scans included: whoever misses it hangs.
    std::chrono::milliseconds testDeadline{60'000};
    /// The same for everything that the service answers from what it knows.
    std::chrono::milliseconds queryDeadline{10'000};
    /// Called when a change of power is asked for; what it returns is kept until the change came or could not be
    /// made. May be empty. On the thread that asks.
    std::function<std::shared_ptr<void>()> expectPowerChange;
    /// Called with each note of the service and with the reason when it is given up; on any thread.
    std::function<void(std::string_view)> note;
};

/// The services of this machine, answered by a service process of its own. *Any* thread.
///
/// What befalls the process comes back as an error with a reason, never as an answer: code 4 when it ended or
/// closed the connection, 7 when it missed a deadline (it is killed then), 8 when
/// requests were cancelled, 10 when an answer is not understood. Once requests have been cancelled, whatever
/// was waiting and whatever test or status is asked later is answered at once with "cancelled (code 8)",
/// also by a service that hangs.
class LiveService {
  public:
    /// Takes over a process whose greeting has been read.
    LiveService(ServiceProcess process, LiveServiceOptions options);
    /// Ends the process; nothing of it is left. No request may be outstanding, and power callbacks come no
    /// more.
    ~LiveService();

    DiagnosticsClient& diagnostics();

    /// The Wi-Fi manager. The process is asked for the radio, the devices and the power when a radio or a
    /// client is; after that the power is what it last told. Callbacks come on the run loop that the client
    /// was scheduled on. A radio that cannot be asked for is none, and a note says why.
    WiFiManagerService& wifi();

    /// Why the process can no longer be used; nothing while it can.
    std::optional<Error> failure() const;

  private:
    class Parts;
    std::unique_ptr<Parts> parts_;
};

}  // namespace wp
