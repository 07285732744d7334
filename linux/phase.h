#pragma once

#include <array>
#include <functional>
#include <memory>

#include "linux/config.h"
#include "linux/gather.h"
#include "linux/notes.h"
#include "linux/workers.h"
#include "service/catalogue.h"

namespace wp {

/// What the workers of all phases share: each is safe to use from several threads.
struct Sources {
    std::optional<std::string> interfaceName;  ///< as the user named it
    Notes notes;
    HomeChannel home;
    Scanner scanner{notes, home};
    EchoSocket gatewayEcho;
    EchoSocket outsideEcho;
    Config config = Config::defaults();
    bool traced = false;  ///< whether a note says when each fact was gathered
};

/// What one phase is about. That of the joined network is about the device, too.
struct PhaseTopic {
    Subject subject = Subject::joined;
    std::optional<NetworkName> named;
    std::chrono::milliseconds oldestScan{0};
    bool isJoined() const { return subject == Subject::network && !named; }
    friend bool operator==(const PhaseTopic&, const PhaseTopic&) = default;
};

struct FactRow;

/// The facts of a row of requests with the same configuration. Each fact is gathered once, on a worker's thread as
/// soon as what it builds on is there; requests wait for their facts. Owner's thread; workers read only facts
/// that are complete.
class Phase : public std::enable_shared_from_this<Phase> {
  public:
    Phase(PhaseTopic topic, Sources& sources, Workers& workers, std::shared_ptr<const StopSignal> stop,
          std::function<void()> onProgress);

    const PhaseTopic& topic() const { return topic_; }
    const Facts& facts() const { return facts_; }

    /// Begins to gather all that the phase's tests need, so that it takes as long as its slowest fact.
    void begin();
    /// Whether all facts of the test are there, or known not to be had.
    bool isReady(const NumberedTest& test) const;

  private:
    enum class State { idle, wanted, running, done };

    State& state(Fact fact) { return states_[static_cast<std::size_t>(fact)]; }
    State state(Fact fact) const { return states_[static_cast<std::size_t>(fact)]; }
    std::shared_ptr<HomeChannel::Stay>& stay(Fact fact) { return stays_[static_cast<std::size_t>(fact)]; }
    bool isAbout(const NumberedTest& test) const;
    /// The fact that stands for this one in this phase; nothing when the phase needs none.
    std::optional<Fact> resolved(Fact fact) const;
    void want(Fact fact);
    void launchWhatCan();
    void launch(const FactRow& row);
    void trace(const FactRow& row, Clock::time_point begin, Clock::duration waited) const;

    PhaseTopic topic_;
    std::int64_t startedAt_ = bootMilliseconds();
    Clock::time_point traceStart_ = Clock::now();
    Sources& sources_;
    Workers& workers_;
    std::shared_ptr<const StopSignal> stop_;
    std::function<void()> onProgress_;
    Facts facts_;
    std::array<State, kFactCount> states_{};
    /// Of the facts that need the home channel, from when they are wanted until they are there.
    std::array<std::shared_ptr<HomeChannel::Stay>, kFactCount> stays_;
};

}  // namespace wp
