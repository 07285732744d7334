#include "linux/files/dhcpcd_leases.h"

#include <sys/stat.h>

#include <algorithm>

#include "linux/files/dhcp_packet.h"
#include "linux/files/folder.h"
#include "linux/files/key_value_file.h"

namespace wp {
namespace {

// Debian's, and the program's own.
constexpr const char* kFolders[] = {"/var/lib/dhcpcd", "/var/db/dhcpcd"};
constexpr std::size_t kLongestPacket = 65536, kMostLeases = 10'000;
constexpr std::uint32_t kWithoutEnd = 0xFFFFFFFF;

/// "wlan0.lease" and, for each network, "wlan0-NAME.lease"; those of DHCPv6 end in "6".
bool isLeaseOf(const std::string& file, const std::string& interfaceName, const char* ending) {
    return file.starts_with(interfaceName) && file.ends_with(ending) && file.size() > interfaceName.size() &&
           (file[interfaceName.size()] == '-' || file[interfaceName.size()] == '.');
}

/// A lease, and when it was granted: its file is as old as the server's answer.
struct KeptLease {
    std::int64_t grantedAt = 0;
    Lease lease;
};

/// The lease in the file, where it is in force.
std::optional<KeptLease> leaseIn(const std::string& path, std::optional<GrantedLease> (*read)(Bytes),
                                 const std::vector<IPAddress>& assigned, std::int64_t now) {
    struct stat about {};
    const auto content = readSmallFile(path, kLongestPacket);
    if (!content || ::stat(path.c_str(), &about) != 0) return std::nullopt;
    auto granted = read({reinterpret_cast<const std::uint8_t*>(content->data()), content->size()});
    if (!granted) return std::nullopt;
    const std::int64_t grantedAt = about.st_mtim.tv_sec;
    const bool isOver = granted->seconds != kWithoutEnd && grantedAt + std::int64_t{granted->seconds} <= now;
    const bool isHere = std::ranges::any_of(granted->lease.addresses,
                                            [&](const IPAddress& each) { return contains(assigned, each); });
    if (isOver || !isHere) return std::nullopt;
    return KeptLease{grantedAt, std::move(granted->lease)};
}

/// Two networks may grant the same address: the later lease counts.
void keepLater(std::optional<KeptLease>& kept, std::optional<KeptLease> other) {
    if (other && (!kept || kept->grantedAt < other->grantedAt)) kept = std::move(other);
}

std::optional<Lease> leaseOf(std::optional<KeptLease> kept) {
    return kept ? std::optional(std::move(kept->lease)) : std::nullopt;
}

}  // namespace

DhcpcdLeases findDhcpcdLeases(const std::string& interfaceName, const std::vector<IPAddress>& assigned,
                              std::int64_t now, const std::string& root) {
    std::optional<KeptLease> ipv4, ipv6;
    for (const char* folder : kFolders) {
        for (const std::string& name : namesIn(root + folder, kMostLeases)) {
            const std::string path = root + folder + "/" + name;
            if (isLeaseOf(name, interfaceName, ".lease"))
                keepLater(ipv4, leaseIn(path, readDhcpPacket, assigned, now));
            if (isLeaseOf(name, interfaceName, ".lease6"))
                keepLater(ipv6, leaseIn(path, readDhcp6Message, assigned, now));
        }
    }
    return {leaseOf(std::move(ipv4)), leaseOf(std::move(ipv6))};
}

}  // namespace wp
