#pragma once

#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <set>
#include <string>
#include <thread>
#include <variant>
#include <vector>

#include "exchange/descriptor.h"
#include "exchange/service_process.h"
#include "exchange/wire.h"

namespace wp {

/// The conversation with one service process: several requests may be outstanding, each from a thread of its
/// own, while one thread inside carries the lines. *Any* thread.
///
/// A service that ends, closes the connection, sends what is no message or lets a deadline
/// pass is given up for good: it is killed, and every request, outstanding or later, is answered with an error
/// that says what happened. Codes: 4 not there any more, 7 no answer in time, 8 cancelled, 10 not understood.
class ServiceConnection {
  public:
    using Duration = std::chrono::milliseconds;
    using Outcome = std::variant<WireAnswer, Error>;

    /// Called under no lock: changes of power on the thread inside, notes (the service's own, and why it is given up)
    /// on any thread.
    struct Handlers {
        std::function<void(bool power)> powerChanged;
        std::function<void(std::string_view text)> note;
    };

    ServiceConnection(ServiceProcess process, Handlers handlers);
    /// Ends the service; requests still outstanding are cancelled, but must have returned before.
    ~ServiceConnection();
    ServiceConnection(const ServiceConnection&) = delete;
    ServiceConnection& operator=(const ServiceConnection&) = delete;

    /// Sends the request, whose number is filled in, and waits for its answer. `arrived` is called with it on
    /// the thread inside, before any later message is looked at.
    Outcome ask(WireRequest request, Duration deadline,
                std::function<void(const WireAnswer&)> arrived = nullptr);

    /// Sends the request without waiting; `arrived` is called as above, not at all when no answer comes.
    void tell(WireRequest request, std::function<void(const WireAnswer&)> arrived);

    /// Ends every outstanding request at once with `cancelledError`, whatever the service does, and tells the
    /// service. Every later test and status query ends so too, without being sent.
    void cancel();

    /// Why the service has been given up; nothing while it has not.
    std::optional<Error> failure() const;

  private:
    struct Pending {
        std::function<void(const WireAnswer&)> arrived;
        std::optional<Outcome> outcome;
    };
    using PendingPointer = std::shared_ptr<Pending>;

    std::variant<std::uint64_t, Error> post(WireRequest& request, PendingPointer pending);
    void wake();
    void giveUp(Error error);

    void carry();
    bool exchangeOnce();
    bool receive();
    void send();
    bool takeLines();
    bool takeMessage(std::string_view line);
    bool takeAnswer(WireAnswer answer);
    Error endOfService();

    Handlers handlers_;
    ServiceProcess process_;  // the thread inside alone, once it runs
    Descriptor wakeup_;
    std::string incoming_;  // the thread inside alone
    std::size_t searched_ = 0;

    mutable std::mutex mutex_;
    std::condition_variable answered_;
    std::map<std::uint64_t, PendingPointer> pending_;
    std::uint64_t lastID_ = 0;
    std::string outgoing_;
    std::optional<Error> failure_;
    bool isCancelled_ = false;
    bool isStopping_ = false;

    std::thread thread_;
};

}  // namespace wp
