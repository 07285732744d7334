#include "linux/echo_message.h"

namespace wp {
namespace {

constexpr std::uint8_t kRequest4 = 8;
constexpr std::uint8_t kReply4 = 0;
constexpr std::uint8_t kRequest6 = 128;
constexpr std::uint8_t kReply6 = 129;
constexpr std::size_t kHeaderSize = 8;
constexpr std::size_t kContentSize = 56;  // as the usual tools send
constexpr std::size_t kSmallestIPv4Header = 20;

std::uint16_t checksumOf(Bytes bytes) {
    std::uint32_t sum = 0;
    for (std::size_t i = 0; i + 1 < bytes.size(); i += 2) sum += std::uint32_t{bytes[i]} << 8 | bytes[i + 1];
    while (sum > 0xFFFF) sum = (sum & 0xFFFF) + (sum >> 16);
    return static_cast<std::uint16_t>(~sum);
}

void putBigEndian(std::vector<std::uint8_t>& bytes, std::size_t at, std::uint16_t number) {
    bytes[at] = static_cast<std::uint8_t>(number >> 8);
    bytes[at + 1] = static_cast<std::uint8_t>(number);
}

std::uint16_t bigEndian16(Bytes bytes, std::size_t at) {
    return static_cast<std::uint16_t>(bytes[at] << 8 | bytes[at + 1]);
}

}  // namespace

std::vector<std::uint8_t> echoRequest(Address::Family family, EchoTag tag) {
    std::vector<std::uint8_t> message(kHeaderSize + kContentSize);
    message[0] = family == Address::Family::ipv4 ? kRequest4 : kRequest6;
    putBigEndian(message, 4, tag.identifier);
    putBigEndian(message, 6, tag.sequence);
    for (std::size_t i = kHeaderSize; i < message.size(); ++i) message[i] = static_cast<std::uint8_t>(i);
    if (family == Address::Family::ipv4) putBigEndian(message, 2, checksumOf(message));
    return message;
}

std::optional<EchoTag> readEchoReply(Address::Family family, EchoFraming framing, Bytes packet) {
    if (framing == EchoFraming::behindIPv4Header) {
        const std::size_t header = packet.empty() ? 0 : std::size_t{4} * (packet[0] & 15U);
        if (header < kSmallestIPv4Header || packet.size() < header) return std::nullopt;
        packet = packet.subspan(header);
    }
    if (packet.size() < kHeaderSize || packet[0] != (family == Address::Family::ipv4 ? kReply4 : kReply6)) {
        return std::nullopt;
    }
    return EchoTag{bigEndian16(packet, 4), bigEndian16(packet, 6)};
}

}  // namespace wp
