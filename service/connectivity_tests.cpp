#include "service/connectivity_tests.h"

#include <algorithm>
#include <cmath>

namespace wp {
namespace {

bool isLinkLocal(const Address& address) {
    if (address.family == Address::Family::ipv4) return address.bytes[0] == 169 && address.bytes[1] == 254;
    return address.bytes[0] == 0xFE && (address.bytes[1] & 0xC0) == 0x80;
}

bool isUnspecified(const Address& address) {
    return std::ranges::all_of(address.bytes, [](std::uint8_t byte) { return byte == 0; });
}

/// Addresses of unique-local IPv6 prefixes count; such a network reaches at least itself.
Outcome hasAddress(const Facts& facts, Address::Family family) {
    if (facts.link && !facts.link->joined) {
        return failure(Reason::notJoined, facts.link->interfaceName + " is not joined to a network");
    }
    if (!facts.addresses) return facts.addresses.error();
    return works(std::ranges::any_of(*facts.addresses, [&](const Address& address) {
        return address.family == family && address.global && address.usable && !isLinkLocal(address) &&
               !isUnspecified(address);
    }));
}

}  // namespace

PingStatistics statisticsOf(const Echo& echo) {
    PingStatistics statistics;
    statistics.interfaceName = echo.interfaceName;
    statistics.count = static_cast<std::int64_t>(echo.roundTrips.size());
    statistics.timestamp = echo.startedAt;
    std::vector<double> times;
    for (const std::optional<double>& time : echo.roundTrips) {
        if (time) times.push_back(*time);
    }
    if (!echo.roundTrips.empty()) {
        const std::size_t lost = echo.roundTrips.size() - times.size();
        statistics.packetLoss = static_cast<double>(lost) / static_cast<double>(echo.roundTrips.size());
    }
    if (times.empty()) return statistics;
    const double count = static_cast<double>(times.size());
    double sum = 0;
    for (const double time : times) sum += time;
    double squares = 0;
    for (const double time : times) squares += (time - sum / count) * (time - sum / count);
    statistics.min = std::ranges::min(times);
    statistics.max = std::ranges::max(times);
    statistics.avg = sum / count;
    statistics.stddev = std::sqrt(squares / count);
    return statistics;
}

Outcome gatewayAnswers(const Facts& facts) {
    if (!facts.gatewayEcho) return facts.gatewayEcho.error();
    return works(facts.gatewayEcho->isAnswered(),
                 {{"PingResult", std::make_shared<PingStatistics>(statisticsOf(*facts.gatewayEcho))}});
}

Outcome hasIPv4Address(const Facts& facts) {
    return hasAddress(facts, Address::Family::ipv4);
}

Outcome hasIPv6Address(const Facts& facts) {
    return hasAddress(facts, Address::Family::ipv6);
}

}  // namespace wp
