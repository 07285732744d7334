#include "linux/fact_table.h"

#include <algorithm>
#include <limits>

#include "linux/gather_reach.h"
#include "linux/gather_setup.h"
#include "linux/within_memory.h"
#include "service/thresholds.h"

namespace wp {
namespace {

using namespace std::chrono_literals;

/// A reason that names what is missing on this machine also names what that costs; a missing permission, which a
/// person can mend, is worth a note too.
Error withLoss(const Gathering& g, Error error) {
    const bool denied = error.code == static_cast<int>(Reason::notPermitted);
    if (!denied && error.code != static_cast<int>(Reason::unavailable)) return error;
    error.message += std::string("; without it nobody can tell ") + g.loss;
    if (denied) g.sources.notes.once(g.loss, error.message);
    return error;
}

template <class T>
Store kept(Known<T> Facts::*place, Known<T> found) {
    return [place, found = std::move(found)](Facts& into) { into.*place = found; };
}

template <class T>
Store stored(const Gathering& g, Known<T> Facts::*place, Known<T> found) {
    if (!found) found = withLoss(g, found.error());
    return kept(place, std::move(found));
}

/// A store of what the function makes of the link, or of the reason why there is no link.
template <class T, class Gather>
Store fromLink(const Gathering& g, Known<T> Facts::*place, Gather gather) {
    if (!g.facts.link) return kept<T>(place, g.facts.link.error());
    return stored(g, place, withinMemory([&] { return Known<T>(gather(*g.facts.link)); }));
}

Error leavesByAnother(const Link& link) {
    return failure(Reason::notJoined, link.interfaceName + " only stands by in " + link.master->name +
                                          ": what this device sends leaves by another interface");
}

/// The same of what has the link's addresses: the interface, or the bridge or bond that it is part of.
template <class T, class Gather>
Store fromAddressed(const Gathering& g, Known<T> Facts::*place, Gather gather) {
    return fromLink(g, place, [&](const Link& found) -> Known<T> { return gather(addressed(found)); });
}

/// The same of what is asked over the network, which must be asked by this interface. What the network answered, or did
/// not, says nothing of it where the device has lost it meanwhile.
template <class T, class Gather>
Store overNetwork(const Gathering& g, Known<T> Facts::*place, Gather gather) {
    return fromLink(g, place, [&](const Link& found) -> Known<T> {
        if (found.master && found.master->sendsElsewhere) return leavesByAnother(found);
        Known<T> told = gather(addressed(found));
        if (!hasLostNetwork(found, g.until)) return told;
        return failure(Reason::notJoined, found.interfaceName + " has lost its network meanwhile");
    });
}

Known<Link> linkOf(const Gathering& g) {
    Known<Link> link = gatherLink(g.sources.interfaceName, g.until);
    if (link && link->master)
        g.sources.notes.once(
            link->interfaceName + " is part of " + link->master->name +
            ", which has its addresses: they, and what is asked over the network, are those of " +
            link->master->name);
    if (g.topic.isJoined() && link && link->joined && optsOutOfTests(link->joined->says.name)) {
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
        return {link.interfaceName, link.interfaceIndex,         link.radio,
                freshEnough(g),     ScanWish::Manner::listening, g.topic.named};
    }
    constexpr std::int64_t kNever = std::numeric_limits<std::int64_t>::max();
    return {link.interfaceName,        link.interfaceIndex, link.radio, kNever,
            ScanWish::Manner::calling, std::nullopt};
}

Store link(const Gathering& g) {
    return stored(g, &Facts::link, withinMemory([&] { return linkOf(g); }));
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
    return fromAddressed(g, &Facts::addresses,
                         [&](const Link& found) { return gatherAddresses(found, g.until); });
}

Store gatewayEcho(const Gathering& g) {
    return overNetwork(g, &Facts::gatewayEcho, [&](const Link& found) {
        Known<Echo> echo = gatherGatewayEcho(found, g.sources.gatewayEcho, *g.stay, g.until);
        if (echo && !echo->isAnswered() && answersAsNeighbour(found, echo->target, g.until))
            g.sources.notes.once("the router " + echo->target +
                                 " is there, but ignores echo requests (ping)");
        return echo;
    });
}

Store setup(const Gathering& g) {
    return fromAddressed(g, &Facts::setup, [&](const Link& found) { return gatherSetup(found, g.until); });
}

Store saved(const Gathering& g) {
    return fromLink(g, &Facts::saved, [&](const Link& found) { return gatherSaved(found, g.until); });
}

Store bluetooth(const Gathering& g) {
    return stored(g, &Facts::bluetooth, withinMemory([&] { return gatherBluetooth(g.until); }));
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

/// Of a channel that the radio does not stay on hardly anything is counted.
Store airtime(const Gathering& g) {
    return fromLink(g, &Facts::airtime, [&](const Link& found) -> Known<Airtime> {
        if (g.topic.named) return Airtime();
        return gatherAirtime(found, *g.stay, g.until);
    });
}

Store allowedChannels(const Gathering& g) {
    return fromLink(g, &Facts::allowedChannels,
                    [&](const Link& found) { return gatherAllowedChannels(found, g.until); });
}

Store outsideEcho(const Gathering& g) {
    return overNetwork(g, &Facts::outsideEcho, [&](const Link& found) {
        return gatherOutsideEcho(found, g.sources.config.endpoints, g.sources.outsideEcho, *g.stay, g.until);
    });
}

/// A store of what the function makes of the link and its set-up, or of the reason why one of them is missing.
template <class T, class Gather>
Store fromSetup(const Gathering& g, Known<T> Facts::*place, Gather gather) {
    if (g.facts.link && !g.facts.setup) return kept<T>(place, g.facts.setup.error());
    return overNetwork(g, place, [&](const Link& found) { return gather(found, *g.facts.setup); });
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
    return overNetwork(g, &Facts::router, [&](const Link& found) { return gatherRouter(found, g.until); });
}

Store translation(const Gathering& g) {
    return fromSetup(g, &Facts::translation, [&](const Link& found, const LinkSetup& how) {
        const auto told = g.facts.router ? g.facts.router->external : std::nullopt;
        return gatherTranslation(found, how, told, g.sources.config.endpoints, g.until);
    });
}

constexpr Fact kLink[] = {Fact::link};
constexpr Fact kSetup[] = {Fact::link, Fact::setup};
constexpr Fact kTranslation[] = {Fact::link, Fact::setup, Fact::router};
constexpr Fact kNearby[] = {Fact::nearby};
// While a scan visits other channels echo requests would be lost and delayed, answers that are timed would be late, and
// other channels counted.
constexpr HomeUse kAny = HomeUse::none, kHome = HomeUse::needed, kFirst = HomeUse::neededAtFirst,
                  kAway = HomeUse::left;

// clang-format off
constexpr FactRow kRows[] = {
    // fact                       name                    needs          after     home    most           gather                loss
    {Fact::link,                 "link",                 {},            {},       kAny,   3s,            link,                 "anything about Wi-Fi"},
    // What takes longest comes first.
    {Fact::gatewayEcho,          "gatewayEcho",          kLink,         {},       kHome,  4s,            gatewayEcho,          "whether the router and others answer"},
    {Fact::outsideEcho,          "outsideEcho",          kLink,         {},       kHome,  4s,            outsideEcho,          "whether the router and others answer"},
    {Fact::airtime,              "airtime",              kLink,         {},       kHome,  10s,           airtime,              "how busy the channels are"},
    // The slowest radios listen through two bands in 12 s.
    {Fact::nearby,               "nearby",               kLink,         {},       kAway,  30s,           nearby,               "which networks are near"},
    {Fact::listened,             "listened",             kLink,         kNearby,  kAway,  20s,           listened,             "which networks hide"},
    {Fact::station,              "station",              kLink,         {},       kAny,   3s,            station,              "how strong the signal is"},
    {Fact::survey,               "survey",               kLink,         {},       kAny,   3s,            survey,               "how loud the noise is"},
    {Fact::regulation,           "regulation",           kLink,         {},       kAny,   3s,            regulation,           "the radio's country"},
    {Fact::addresses,            "addresses",            kLink,         {},       kAny,   3s,            addresses,            "the addresses"},
    {Fact::setup,                "setup",                kLink,         {},       kAny,   4s,            setup,                "how the device is set up"},
    {Fact::saved,                "saved",                kLink,         {},       kAny,   4s,            saved,                "the remembered networks"},
    {Fact::bluetooth,            "bluetooth",            {},            {},       kAny,   3s,            bluetooth,            "the Bluetooth devices"},
    {Fact::driverSharesAirtime,  "driverSharesAirtime",  kLink,         {},       kAny,   1s,            driverSharesAirtime,  "how Bluetooth shares airtime"},
    {Fact::peerLinks,            "peerLinks",            kLink,         {},       kAny,   3s,            peerLinks,            "the peer-to-peer links"},
    {Fact::allowedChannels,      "allowedChannels",      kLink,         {},       kAny,   3s,            allowedChannels,      "the channels to choose from"},
    {Fact::nameAnswer,           "nameAnswer",           kSetup,        {},       kFirst, 4s,            nameAnswer,           "whether names resolve"},
    {Fact::portal,               "portal",               kSetup,        {},       kFirst, 5s,            portal,               "whether there is a portal"},
    {Fact::vendorService,        "vendorService",        kSetup,        {},       kFirst, kServiceTime,  vendorService,        "whether the vendor is reached"},
    {Fact::router,               "router",               kLink,         {},       kAny,   4s,            router,               "who made the router"},
    {Fact::translation,          "translation",          kTranslation,  {},       kAny,   3s,            translation,          "how often addresses are translated"},
};
// clang-format on

}  // namespace

std::span<const FactRow> factRows() {
    return kRows;
}

const FactRow& rowOf(Fact fact) {
    return *std::ranges::find(kRows, fact, &FactRow::fact);
}

}  // namespace wp
