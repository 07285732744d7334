#include "linux/probe/port_mapping.h"

#include <algorithm>

namespace wp {
namespace {

constexpr std::uint8_t kPcp = 2, kMap = 1, kAnswer = 0x80, kUdp = 17;
constexpr std::size_t kPcpHeader = 24, kPcpMap = 36;

unsigned bigEndian16(Bytes bytes, std::size_t at) {
    return bytes[at] << 8U | bytes[at + 1];
}

void put16(std::vector<std::uint8_t>& into, unsigned value) {
    into.push_back(static_cast<std::uint8_t>(value >> 8));
    into.push_back(static_cast<std::uint8_t>(value & 0xFF));
}

/// An IPv4 address as PCP carries it, mapped into IPv6.
void putAddress(std::vector<std::uint8_t>& into, const IPAddress& address) {
    if (address.isIPv4()) into.insert(into.end(), {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0xFF, 0xFF});
    into.insert(into.end(), address.bytes().begin(), address.bytes().end());
}

}  // namespace

std::vector<std::uint8_t> externalAddressRequest() {
    return {0, 0};
}

std::optional<PortMappingAnswer> readExternalAddress(Bytes message) {
    if (message.size() < 4 || (message[1] & kAnswer) == 0) return std::nullopt;
    const unsigned result = bigEndian16(message, 2);
    // A router of the younger protocol answers in its own form that the version is not supported.
    if (message[0] == kPcp || result == 1) return PortMappingAnswer{std::nullopt, message[0] == kPcp};
    if (message[0] != 0 || message[1] != kAnswer || message.size() < 12) return std::nullopt;
    if (result != 0) return PortMappingAnswer{};
    const auto address = IPAddress::fromBytes(message.subspan(8, 4));
    // Before its own connection is up a router may answer with zeros.
    if (address && address->unspecified()) return PortMappingAnswer{};
    return PortMappingAnswer{address, false};
}

std::vector<std::uint8_t> pcpMapRequest(const IPAddress& own, std::uint16_t port, const PcpNonce& nonce,
                                        std::uint32_t seconds) {
    std::vector<std::uint8_t> request = {kPcp, kMap, 0, 0};
    put16(request, seconds >> 16);
    put16(request, seconds & 0xFFFF);
    putAddress(request, own);
    request.insert(request.end(), nonce.begin(), nonce.end());
    request.insert(request.end(), {kUdp, 0, 0, 0});
    put16(request, port);
    put16(request, 0);  // any port outside will do
    putAddress(request, own.isIPv4() ? IPAddress() : *IPAddress::fromText("::"));
    return request;
}

std::optional<IPAddress> addressFromPcp(Bytes message, const PcpNonce& nonce) {
    if (message.size() < kPcpHeader + kPcpMap || message[0] != kPcp || message[1] != (kAnswer | kMap) ||
        message[3] != 0)
        return std::nullopt;
    const Bytes map = message.subspan(kPcpHeader);
    if (!std::equal(nonce.begin(), nonce.end(), map.begin())) return std::nullopt;
    const auto address = IPAddress::fromBytes(map.subspan(20, 16));
    return address && !address->unspecified() ? address : std::nullopt;
}

}  // namespace wp
