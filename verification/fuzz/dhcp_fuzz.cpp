#include "linux/files/dhcp_packet.h"

using namespace wp;

/// A server's answer as a DHCP client kept it.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const Bytes answer(data, size);
    readDhcpPacket(answer);
    readDhcp6Message(answer);
    return 0;
}
