#pragma once

#include <mutex>

#include "linux/echo_message.h"
#include "linux/home_channel.h"
#include "linux/stop_signal.h"
#include "service/ip_address.h"

namespace wp {

/// Sends echo requests. It is opened while the program still has its privileges; sending needs none. One row of
/// requests at a time, *any* thread.
class EchoSocket {
  public:
    /// Datagram sockets where the system lets this user have them, else raw ones, where it is privileged.
    EchoSocket();

    /// Sends 5 requests at least 200 ms apart out of the interface and waits up to 1 s for each answer, all at once.
    /// Every peer waits about that long, and a home network answers within a few milliseconds. The radio may leave the
    /// channel between an answer and the next request, which waits for its return, but no longer than 1.5 s from the
    /// first one on. Where nothing at all has come 300 ms after the last request, more than a second after the first,
    /// the row seems to be lost: it ends its stay and waits on.
    Known<Echo> ask(const IPAddress& target, const std::string& interfaceName, std::uint32_t interfaceIndex,
                    HomeChannel::Stay& stay, const Until& until);

  private:
    struct End {
        Descriptor descriptor;
        bool raw = false;
        int error = 0;  ///< why there is none
    };
    static End open(Address::Family family);
    End& end(Address::Family family) { return family == Address::Family::ipv4 ? ipv4_ : ipv6_; }

    std::mutex asking_;
    End ipv4_;
    End ipv6_;
};

/// Seconds since 2001-01-01 00:00:00 UTC.
double secondsSinceReference();

}  // namespace wp
