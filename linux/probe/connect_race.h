#pragma once

#include <poll.h>

#include <string>
#include <vector>

#include "linux/probe/ip_socket.h"
#include "linux/wait_any.h"

namespace wp {

/// Connects to whichever address of a host answers first: the families by turns, the next address a quarter of a
/// second after the last, or as soon as that has failed (RFC 8305). Owner's thread; nothing blocks.
class ConnectRace {
  public:
    /// \param interfaceName empty: any
    ConnectRace(const std::vector<IPAddress>& addresses, std::uint16_t port, std::string interfaceName);

    /// Starts what is due and looks at what has become of the others.
    void advance(Clock::time_point now);
    /// What to wait for before it is worth advancing again; `wake` becomes earlier where an address is due before.
    void addWaits(std::vector<pollfd>& waits, Clock::time_point& wake) const;

    bool connected() const { return bool(winner_); }
    /// Whether no address is left.
    bool failed() const { return !winner_ && next_ == addresses_.size() && running_.empty(); }
    /// The last failure, in words.
    const std::string& why() const { return why_; }
    /// The address that has answered; only after `connected`.
    const IPAddress& address() const { return winnersAddress_; }
    /// Gives the connection away.
    Descriptor take() { return std::move(winner_); }

  private:
    struct Attempt {
        IPAddress address;
        Descriptor socket;
    };

    void start(Clock::time_point now);
    /// Whether the attempt is over.
    bool settle(Attempt& attempt);

    std::vector<IPAddress> addresses_;
    std::uint16_t port_;
    std::string interfaceName_;
    unsigned interfaceIndex_;
    std::size_t next_ = 0;
    Clock::time_point nextStart_{};
    std::vector<Attempt> running_;
    Descriptor winner_;
    IPAddress winnersAddress_;
    std::string why_;
};

}  // namespace wp
