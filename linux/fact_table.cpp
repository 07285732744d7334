#include "linux/fact_table.h"

#include <algorithm>
#include <limits>

#include "linux/gather_reach.h"
#include "linux/gather_setup.h"

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

Store setup(const Gathering& g) {
    return fromLink(g, &Facts::setup, [&](const Link& found) { return gatherSetup(found, g.until); });
}

Store saved(const Gathering& g) {
    return fromLink(g, &Facts::saved, [&](const Link& found) { return gatherSaved(found, g.until); });
}

Store bluetooth(const Gathering& g) {
    return [found = gatherBluetooth(g.until)](Facts& into) { into.bluetooth = found; };
}

Store driverSharesAirtime(const Gathering& g) {
    return fromLink(g, &Facts::driverSharesAirtime,
                    [](const Link& found) { return gatherAirtimeSharing(found); });
}

Store peerLinks(const Gathering& g) {
    return fromLink(g, &Facts::peerLinks, [&](const Link& found) {
        return gatherPeerLinks(found, g.sources.config.peerLinkIndicator, g.until);
    });
}

Store airtime(const Gathering& g) {
    return fromLink(g, &Facts::airtime, [&](const Link& found) { return gatherAirtime(found, g.until); });
}

Store allowedChannels(const Gathering& g) {
    return fromLink(g, &Facts::allowedChannels,
                    [&](const Link& found) { return gatherAllowedChannels(found, g.until); });
}

Store outsideEcho(const Gathering& g) {
    return fromLink(g, &Facts::outsideEcho, [&](const Link& found) {
        return gatherOutsideEcho(found, g.sources.config.endpoints, g.sources.outsideEcho, g.until);
    });
}

/// A store of what the function makes of the link and its set-up, or of the reason why one of them is missing.
template <class T, class Gather>
Store fromSetup(const Gathering& g, Known<T> Facts::*place, Gather gather) {
    return fromLink(g, place, [&](const Link& found) -> Known<T> {
        if (!g.facts.setup) return g.facts.setup.error();
        return gather(found, *g.facts.setup);
    });
}

Store nameAnswer(const Gathering& g) {
    return fromSetup(g, &Facts::nameAnswer, [&](const Link& found, const LinkSetup& how) {
        return gatherNameAnswer(found, how, g.sources.config.endpoints, g.until);
    });
}

Store portal(const Gathering& g) {
    return fromSetup(g, &Facts::portal, [&](const Link& found, const LinkSetup& how) {
        return gatherPortal(found, how, g.sources.config.endpoints, g.until);
    });
}

Store vendorService(const Gathering& g) {
    return fromSetup(g, &Facts::vendorService, [&](const Link& found, const LinkSetup& how) {
        return gatherVendorService(found, how, g.sources.config.endpoints, g.until);
    });
}

Store router(const Gathering& g) {
    return fromLink(g, &Facts::router, [&](const Link& found) { return gatherRouter(found, g.until); });
}

Store translation(const Gathering& g) {
    return fromSetup(g, &Facts::translation, [&](const Link& found, const LinkSetup& how) {
        const auto told = g.facts.router ? g.facts.router->external : std::nullopt;
        return gatherTranslation(found, how, told, g.sources.config.endpoints, g.until);
    });
}

constexpr Fact kLink[] = {Fact::link};
// A scan leaves the channel for a while; echo requests would be lost and delayed meanwhile.
constexpr Fact kPings[] = {Fact::gatewayEcho, Fact::outsideEcho};
constexpr Fact kSetup[] = {Fact::link, Fact::setup};
constexpr Fact kTranslation[] = {Fact::link, Fact::setup, Fact::router};
constexpr Fact kPingsAndScan[] = {Fact::gatewayEcho, Fact::outsideEcho, Fact::nearby};

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
    {Fact::gatewayEcho,  kLink,  {},     4s,     gatewayEcho},
    {Fact::setup,        kLink,  {},     4s,     setup},
    {Fact::saved,        kLink,  {},     4s,     saved},
    {Fact::bluetooth,    {},     {},     3s,     bluetooth},
    {Fact::driverSharesAirtime, kLink, {}, 1s,   driverSharesAirtime},
    {Fact::peerLinks,    kLink,  {},     3s,     peerLinks},
    {Fact::airtime,      kLink,  {},     4s,     airtime},
    {Fact::allowedChannels, kLink, {},   3s,     allowedChannels},
    {Fact::outsideEcho,  kLink,  {},     4s,     outsideEcho},
    {Fact::nameAnswer,   kSetup, {},     4s,     nameAnswer},
    {Fact::portal,       kSetup, {},     5s,     portal},
    {Fact::vendorService, kSetup, {},    5s,     vendorService},
    {Fact::router,       kLink,  {},     4s,     router},
    {Fact::translation,  kTranslation, {}, 3s,   translation},
};
// clang-format on

}  // namespace

const FactRow& rowOf(Fact fact) {
    return *std::ranges::find(kRows, fact, &FactRow::fact);
}

}  // namespace wp
