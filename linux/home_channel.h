#pragma once

#include <chrono>
#include <mutex>
#include <vector>

#include "linux/stop_signal.h"

namespace wp {

/// How long the radio stays at home between two visits to other channels: long enough that an access point hands over what
/// it kept meanwhile, and that a short exchange goes to and fro. The kernel itself stays for a fifth of a second (mac80211,
/// HZ / 5).
inline constexpr std::chrono::milliseconds kAtHome{30};

/// Shares the radio between those who need it on the channel of the joined network, such as echo requests, and a scan that
/// visits other channels, so that neither falls into the other. *Any* thread; one visitor at a time.
class HomeChannel {
  public:
    /// Somebody who needs the channel, from the beginning on and for as long as this lives, but no longer than `atMost`.
    /// One thread at a time; the channel outlives it.
    class Stay {
      public:
        explicit Stay(HomeChannel& channel, Clock::duration atMost = std::chrono::minutes(1));
        ~Stay() { end(); }
        Stay(const Stay&) = delete;
        Stay& operator=(const Stay&) = delete;

        /// Needs the channel from now on. Where the radio is away this waits until it is back and has settled.
        Wait begin(const Until& until);
        /// Lasts for so long from now on at least.
        void prolong(Clock::duration atLeast);
        /// Until the next `begin` brief visits are welcome, others are not.
        void pause();
        /// Needs the channel no more, nor again. Calling it again changes nothing.
        void end();
        /// How long the radio has been at home since the channel is looked after.
        Clock::duration timeAtHome() const;

      private:
        friend HomeChannel;
        HomeChannel& channel_;
        Clock::time_point end_;
        bool isNeeding_ = true;
    };

    HomeChannel();

    /// A brief visit is one of a single channel: to listen takes a tenth of a second there. A long one takes seconds.
    enum class Visit { brief, lengthy };
    /// Waits until nobody needs the channel during such a visit. Then the radio counts as away until it has `returned`.
    Wait leave(Visit visit, const Until& until);
    void returned();
    /// Somebody else has taken the radio away already, who asks nobody: it counts as away until it has `returned`.
    void leftByOthers();
    /// How long visits have waited for leave since the channel is looked after.
    Clock::duration timeWaited() const;

  private:
    /// When a visit may begin, as far as is known now.
    Clock::time_point leaveTime(Visit visit) const;
    bool isSettled() const;
    void tellVisitor();

    mutable std::mutex mutex_;
    Descriptor changed_;              ///< readable where somebody needs less than when the visitor looked
    std::vector<const Stay*> stays_;  ///< that have not ended before their time
    Clock::time_point startedAt_ = Clock::now();
    Clock::duration timeAway_{0}, timeWaited_{0};
    bool isAway_ = false;
    Clock::time_point leftAt_;
    Clock::time_point returnedAt_ = startedAt_ - kAtHome;
};

}  // namespace wp
