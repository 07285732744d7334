#include "linux/fact_table.h"

#include <algorithm>
#include <limits>

namespace wp {
namespace {

using namespace std::chrono_literals;

/// A store of what the function makes of the link, or of the reason why there is no link.
template <class T, class Gather>
Store fromLink(const Gathering& g, Known<T> Facts::*place, Gather gather) {
    Known<T> found = g.facts.link ? gather(*g.facts.link) : Known<T>(g.facts.link.error());
    return [place, found = std::move(found)](Facts& into) { into.*place = found; };
}

Known<Link> linkOf(const Gathering& g) {
    Known<Link> link = gatherLink(g.sources.interfaceName, g.until);
    const bool aboutJoined = g.topic.subject == Subject::network && !g.topic.named;
    if (aboutJoined && link && link->joined && optsOutOfTests(link->joined->says.name)) {
        return failure(Reason::badConfiguration, "the network's name asks not to be looked at (_nomap)");
    }
    return link;
}

/// A scan that was complete after the phase's first request serves the whole phase, whatever age was asked for.
std::int64_t freshEnough(const Gathering& g) {
    return std::min(g.startOfPhase, bootMilliseconds() - g.topic.oldestScan.count());
}

/// The list wants all that answer, and every time anew; the tests also want to know who hides, and in one go.
ScanWish wishOf(const Gathering& g, const Link& link) {
    if (g.topic.subject != Subject::scan) {
        return {link.interfaceIndex, link.radio, freshEnough(g), ScanWish::Manner::listening, g.topic.named};
    }
    constexpr std::int64_t kNever = std::numeric_limits<std::int64_t>::max();
    return {link.interfaceIndex, link.radio, kNever, ScanWish::Manner::calling, std::nullopt};
}

Error isDown(const Link& link) {
    return failure(Reason::noInterface, link.interfaceName + " is down");
}

Store link(const Gathering& g) {
    return [found = linkOf(g)](Facts& into) { into.link = found; };
}

Store nearby(const Gathering& g) {
    return fromLink(g, &Facts::nearby, [&](const Link& found) -> Known<std::vector<AccessPoint>> {
        if (!found.up) return isDown(found);
        return g.sources.scanner.scan(wishOf(g, found), g.until);
    });
}

Store listened(const Gathering& g) {
    return fromLink(g, &Facts::listened, [&](const Link& found) -> Known<std::vector<AccessPoint>> {
        if (!found.up) return isDown(found);
        return g.sources.scanner.listen(wishOf(g, found), g.until);
    });
}

Store station(const Gathering& g) {
    return fromLink(g, &Facts::station, [&](const Link& found) { return gatherStation(found, g.until); });
}

Store survey(const Gathering& g) {
    return fromLink(g, &Facts::survey, [&](const Link& found) { return gatherSurvey(found, g.until); });
}

Store regulation(const Gathering& g) {
    return fromLink(g, &Facts::regulation,
                    [&](const Link& found) { return gatherRegulation(found, g.until); });
}

Store addresses(const Gathering& g) {
    return fromLink(g, &Facts::addresses, [&](const Link& found) { return gatherAddresses(found, g.until); });
}

Store gatewayEcho(const Gathering& g) {
    return fromLink(g, &Facts::gatewayEcho, [&](const Link& found) {
        return gatherGatewayEcho(found, g.sources.gatewayEcho, g.until);
    });
}

constexpr Fact kLink[] = {Fact::link};
// A scan leaves the channel for a while; echo requests would be lost and delayed meanwhile.
constexpr Fact kPings[] = {Fact::gatewayEcho};
constexpr Fact kPingsAndScan[] = {Fact::gatewayEcho, Fact::nearby};

// clang-format off
constexpr FactRow kRows[] = {
    // fact              needs   after          most  gather
    {Fact::link,         {},     {},            3s,   link},
    {Fact::nearby,       kLink,  kPings,        30s,  nearby},   // a joined radio listens through two bands in 16 s
    {Fact::listened,     kLink,  kPingsAndScan, 20s, listened},
    {Fact::station,      kLink,  {},            3s,   station},
    {Fact::survey,       kLink,  {},            3s,   survey},
    {Fact::regulation,   kLink,  {},            3s,   regulation},
    {Fact::addresses,    kLink,  {},            3s,   addresses},
    {Fact::gatewayEcho,  kLink,  {},            4s,   gatewayEcho},
};
// clang-format on

}  // namespace

const FactRow& rowOf(Fact fact) {
    return *std::ranges::find(kRows, fact, &FactRow::fact);
}

}  // namespace wp
