#include "linux/echo_message.h"
#include "linux/power_switch.h"

using namespace wp;

/// A packet as a socket hands it over, to the readers of small messages.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const Bytes packet(data, size);
    for (const Address::Family family : {Address::Family::ipv4, Address::Family::ipv6}) {
        readEchoReply(family, EchoFraming::bare, packet);
        readEchoReply(family, EchoFraming::behindIPv4Header, packet);
    }
    readSwitchEvent(packet);
    return 0;
}
