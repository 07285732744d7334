#include "linux/probe/stun_message.h"

#include <algorithm>

namespace wp {
namespace {

constexpr std::array<std::uint8_t, 4> kCookie = {0x21, 0x12, 0xA4, 0x42};
constexpr std::size_t kHeader = 20;
constexpr unsigned kBindingSuccess = 0x0101, kMappedAddress = 0x0001, kXorMappedAddress = 0x0020;

unsigned bigEndian16(Bytes bytes, std::size_t at) {
    return bytes[at] << 8U | bytes[at + 1];
}

/// Family and address of an attribute; the port between them is of no interest.
std::optional<IPAddress> addressIn(Bytes body, Bytes mask) {
    if (body.size() < 4) return std::nullopt;
    const std::size_t size = body[1] == 1 ? 4 : body[1] == 2 ? 16 : 0;
    if (size == 0 || body.size() < 4 + size) return std::nullopt;
    std::array<std::uint8_t, 16> bytes{};
    for (std::size_t i = 0; i < size; ++i)
        bytes[i] = static_cast<std::uint8_t>(body[4 + i] ^ (mask.empty() ? 0 : mask[i]));
    return IPAddress::fromBytes({bytes.data(), size});
}

}  // namespace

std::vector<std::uint8_t> stunBindingRequest(const StunTransaction& transaction) {
    std::vector<std::uint8_t> request = {0x00, 0x01, 0x00, 0x00};
    request.insert(request.end(), kCookie.begin(), kCookie.end());
    request.insert(request.end(), transaction.begin(), transaction.end());
    return request;
}

std::optional<IPAddress> addressFromStun(Bytes message, const StunTransaction& transaction) {
    if (message.size() < kHeader || bigEndian16(message, 0) != kBindingSuccess) return std::nullopt;
    // Cookie and transaction, one after the other in the message, are the mask of the address too.
    const Bytes mask = message.subspan(4, 16);
    if (!std::equal(kCookie.begin(), kCookie.end(), mask.begin()) ||
        !std::equal(transaction.begin(), transaction.end(), mask.begin() + 4))
        return std::nullopt;
    const std::size_t length = bigEndian16(message, 2);
    if (length > message.size() - kHeader) return std::nullopt;
    Bytes rest = message.subspan(kHeader, length);
    std::optional<IPAddress> plain;
    while (rest.size() >= 4) {
        const std::size_t size = bigEndian16(rest, 2);
        if (size > rest.size() - 4) break;
        const Bytes body = rest.subspan(4, size);
        if (bigEndian16(rest, 0) == kXorMappedAddress) return addressIn(body, mask);
        if (bigEndian16(rest, 0) == kMappedAddress && !plain) plain = addressIn(body, {});
        rest = rest.subspan(std::min(rest.size(), 4 + (size + 3) / 4 * 4));
    }
    return plain;
}

}  // namespace wp
