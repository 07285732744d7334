#pragma once

#include <chrono>
#include <optional>
#include <span>
#include <vector>

#include "linux/home_channel.h"
#include "linux/radio_socket.h"

namespace wp {

/// The order in which channels are visited: where a scan is cut short, most that is near has been heard. The own
/// channel, then those on which most homes are, then the rest, each group as it was. *Any* thread.
/// @param home MHz, of the joined network
void putLikelyFirst(std::vector<RadioChannel>& channels, std::optional<std::uint32_t> home);

/// How a joined radio that the kernel scans in software is spared the kernel's long stays at home.
struct ScanSlicing {
    bool wanted = false;                ///< else all channels go into one request
    std::optional<std::uint32_t> home;  ///< MHz; a visit there leaves nothing
};

/// One scan as a row of requests, of one channel each where slicing is wanted, else as one request. Says what to ask
/// for next and takes note of what came of it; asks nobody itself. *Any* thread, one at a time.
class ScanRow {
  public:
    /// An order of no channels in particular, which means all, stays one request.
    ScanRow(ScanOrder order, ScanSlicing slicing);

    /// Every channel was visited.
    bool isComplete() const { return isComplete_; }
    /// The same request was aborted twice, or the radio was busy with others' scans again and again.
    bool isGivenUp() const { return starts_ == kStarts || aborts_ == kAborts; }
    /// The request to make now. Not when it is complete.
    ScanOrder next() const;
    /// How the request takes the radio away from the channel it is joined on; nothing where it does not.
    std::optional<HomeChannel::Visit> visit() const;
    /// How long the radio stays at home before it.
    std::chrono::milliseconds pause() const;

    enum class Whose { own, others };
    /// The scan that was asked for, or the one of others that was in its way, came to an end.
    void ended(Whose whose, const ScanEvent& event);
    /// Goes on without the request's channel, which the kernel refuses though it took others before: what a radio may use
    /// can change between two requests. False where nothing tells that it is the channel.
    bool skip();

  private:
    static constexpr int kStarts = 4;
    static constexpr int kAborts = 2;

    bool isAsGood(const ScanEvent& event) const;
    void leaveOut(std::span<const std::uint32_t> visited);

    ScanOrder order_;
    ScanSlicing slicing_;
    std::vector<std::uint32_t> remaining_;  ///< MHz
    int starts_ = 0, aborts_ = 0;           ///< of the present request
    bool wasAway_ = false, wasHeard_ = false, isComplete_ = false;
};

}  // namespace wp
