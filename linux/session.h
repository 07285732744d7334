#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <string>
#include <variant>

#include "exchange/wire.h"
#include "linux/line_socket.h"
#include "linux/phase.h"
#include "linux/power_switch.h"
#include "service/answer.h"

namespace wp {

/// Answers the requests of one host until it closes the wire. Everything but the gathering of facts happens on the
/// thread that calls `run`; a request waits for nothing but its own facts, and cancelling answers all that wait at
/// once, whatever their facts are doing.
class Session {
  public:
    Session(LineSocket& wire, Sources& sources, PowerSwitch& power);
    ~Session();

    /// Tells the host something that a person should know.
    void note(const std::string& text);
    /// Returns when the wire is closed.
    void run();

  private:
    /// A test that waits for its facts.
    struct WaitingTest {
        const NumberedTest* test = nullptr;
        std::shared_ptr<Phase> phase;
        bool isHeld = false;  ///< until it is known whether what was begun ahead still holds
    };
    struct WaitingStatus {};
    struct WaitingDescription {};
    using Waiting = std::variant<WaitingTest, WaitingStatus, WaitingDescription>;

    void handle(const std::string& line);
    void handleTest(const WireRequest& request);
    void handleStatus(std::uint64_t id);
    void handleDescription(std::uint64_t id);
    void handleSetPower(const WireRequest& request);
    void cancel();

    std::shared_ptr<Phase> phaseFor(PhaseTopic topic);
    std::shared_ptr<Phase> begun(const PhaseTopic& topic);
    void lookAgain(const std::shared_ptr<Phase>& phase);
    void release(const std::shared_ptr<Phase>& phase, const Known<Link>& link);
    bool becomesReady(WaitingTest& waiting);
    void answerReadyTests();
    void answerTest(std::uint64_t id, const DiagnosticsTestResponse& response);
    void answerCancelled(std::uint64_t id, const Waiting& waiting);
    void answerSetPower(const WireRequest& request, std::optional<Error> error);
    void finishStatus(std::uint64_t id, const Known<Link>& link);
    void finishDescription(std::uint64_t id, const Known<std::vector<RadioInterface>>& interfaces);
    /// Whether the request still waits; it no longer does afterwards.
    bool take(std::uint64_t id);
    void reportPower();

    LineSocket& wire_;
    Sources& sources_;
    PowerSwitch& power_;
    Inbox inbox_;
    std::shared_ptr<StopSignal> stop_;
    std::shared_ptr<Phase> phase_;  ///< of the latest test request
    std::shared_ptr<Phase> ahead_;  ///< about a network, and begun with a test of the device
    bool toldOfNetwork_ = false;    ///< whether the latest status named a network that may be tested
    std::map<std::uint64_t, Waiting> waiting_;
    std::optional<std::uint32_t> describedRadio_;  ///< the radio whose power the host was told
    bool toldPower_ = false;
    Workers workers_;  ///< last: its threads are waited for while all else is still there
};

/// What a test's configuration asks for, or why it is not acceptable. A pure function.
Known<PhaseTopic> topicOf(const NumberedTest& test, const DictionaryPointer& configuration);

}  // namespace wp
