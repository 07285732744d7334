#include "linux/files/dhcp_packet.h"

#include <algorithm>
#include <map>

#include "service/plain_text.h"

namespace wp {
namespace {

using Buffer = std::vector<std::uint8_t>;
/// The value of each option that is read here, its parts one after another.
using Options = std::map<unsigned, Buffer>;

constexpr std::size_t kLongestVendorText = 2048;

// Of DHCPv4: where the fields of the packet lie, and the options' numbers.
constexpr std::size_t kOwnAddress = 16, kServerName = 44, kServerNameSize = 64, kFile = 108, kFileSize = 128;
constexpr std::size_t kCookie = 236;
constexpr std::uint32_t kMagic = 0x63825363;
constexpr unsigned kPad = 0, kNameServers = 6, kVendorOptions = 43, kLeaseTime = 51, kOverload = 52;
constexpr unsigned kMessageType = 53, kVendorClass = 60, kPortal = 114, kWithdrawnPortal = 160, kEnd = 255;
constexpr std::uint8_t kAcknowledgement = 5;
constexpr unsigned kRead[] = {kNameServers, kVendorOptions, kLeaseTime, kOverload,
                              kMessageType, kVendorClass,   kPortal,    kWithdrawnPortal};

void readOptions(Bytes rest, Options& options) {
    while (!rest.empty() && rest[0] != kEnd) {
        if (rest[0] == kPad) {
            rest = rest.subspan(1);
            continue;
        }
        if (rest.size() < 2 || rest[1] > rest.size() - 2) return;
        const Bytes value = rest.subspan(2, rest[1]);
        if (std::ranges::find(kRead, rest[0]) != std::end(kRead)) {
            Buffer& whole = options[rest[0]];
            whole.insert(whole.end(), value.begin(), value.end());
        }
        rest = rest.subspan(2 + value.size());
    }
}

std::string_view textIn(const Options& options, unsigned number) {
    const auto found = options.find(number);
    if (found == options.end()) return {};
    return {reinterpret_cast<const char*>(found->second.data()), found->second.size()};
}

std::string vendorTextIn(const Options& options) {
    return plainText(textIn(options, kVendorOptions), kLongestVendorText) +
           plainText(textIn(options, kVendorClass), kLongestVendorText);
}

std::vector<IPAddress> addressesIn(const Options& options, unsigned number, std::size_t size) {
    std::vector<IPAddress> addresses;
    const auto found = options.find(number);
    for (Bytes rest = found == options.end() ? Bytes() : Bytes(found->second); rest.size() >= size;
         rest = rest.subspan(size))
        if (const auto address = IPAddress::fromBytes(rest.first(size))) addresses.push_back(*address);
    return addresses;
}

// Of DHCPv6.
constexpr std::uint8_t kReply = 7;
constexpr unsigned kAddressGroup = 3, kAddress = 5, kNameServers6 = 23, kPortal6 = 103;
constexpr std::size_t kHead6 = 4, kGroupHead = 12, kAddressSize = 16, kAddressHead = 24;

/// Calls `visit(number, value)` for each option up to the first that reaches beyond the end.
template <class Visit>
void forEachOption6(Bytes rest, Visit visit) {
    while (rest.size() >= 4) {
        const unsigned number = rest[0] << 8U | rest[1];
        const std::size_t size = static_cast<std::size_t>(rest[2] << 8U | rest[3]);
        if (size > rest.size() - 4) return;
        visit(number, rest.subspan(4, size));
        rest = rest.subspan(4 + size);
    }
}

void addGroup(Bytes group, GrantedLease& granted) {
    if (group.size() < kGroupHead) return;
    forEachOption6(group.subspan(kGroupHead), [&](unsigned number, Bytes value) {
        if (number != kAddress || value.size() < kAddressHead) return;
        // An address with no life left is one that was taken back.
        const std::uint32_t valid = bigEndian32(value, kAddressSize + 4);
        const auto address = IPAddress::fromBytes(value.first(kAddressSize));
        if (valid == 0 || !address) return;
        granted.lease.addresses.push_back(*address);
        granted.seconds = std::max(granted.seconds, valid);
    });
}

}  // namespace

std::optional<GrantedLease> readDhcpPacket(Bytes packet) {
    if (packet.size() < kCookie + 4 || bigEndian32(packet, kCookie) != kMagic) return std::nullopt;
    Options options;
    readOptions(packet.subspan(kCookie + 4), options);
    const Buffer overload = options[kOverload];
    if (overload.size() == 1 && (overload[0] & 1) != 0)
        readOptions(packet.subspan(kFile, kFileSize), options);
    if (overload.size() == 1 && (overload[0] & 2) != 0)
        readOptions(packet.subspan(kServerName, kServerNameSize), options);
    const Buffer &type = options[kMessageType], &time = options[kLeaseTime];
    if (type != Buffer{kAcknowledgement} || time.size() != 4) return std::nullopt;
    GrantedLease granted;
    granted.lease.addresses = {*IPAddress::fromBytes(packet.subspan(kOwnAddress, 4))};
    granted.seconds = bigEndian32(time, 0);
    granted.lease.servers = addressesIn(options, kNameServers, 4);
    granted.lease.vendorText = vendorTextIn(options);
    granted.lease.portalApi = portalUriFrom(textIn(options, kPortal));
    if (granted.lease.portalApi.empty())
        granted.lease.portalApi = portalUriFrom(textIn(options, kWithdrawnPortal));
    return granted;
}

std::optional<GrantedLease> readDhcp6Message(Bytes message) {
    if (message.size() < kHead6 || message[0] != kReply) return std::nullopt;
    GrantedLease granted;
    Options options;
    forEachOption6(message.subspan(kHead6), [&](unsigned number, Bytes value) {
        if (number == kAddressGroup) addGroup(value, granted);
        // Unlike those of DHCPv4 they come whole; the first counts.
        if (number == kNameServers6 || number == kPortal6)
            options.try_emplace(number, value.begin(), value.end());
    });
    if (granted.lease.addresses.empty()) return std::nullopt;
    granted.lease.servers = addressesIn(options, kNameServers6, kAddressSize);
    granted.lease.portalApi = portalUriFrom(textIn(options, kPortal6));
    return granted;
}

}  // namespace wp
