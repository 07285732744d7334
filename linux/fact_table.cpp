#include "linux/fact_table.h"

#include <algorithm>

namespace wp {
namespace {

using namespace std::chrono_literals;

/// A store of what the function makes of the link, or of the reason why there is no link.
template <class T, class Gather>
Store fromLink(const Facts& facts, Known<T> Facts::*place, Gather gather) {
    Known<T> found = facts.link ? gather(*facts.link) : Known<T>(facts.link.error());
    return [place, found = std::move(found)](Facts& into) { into.*place = found; };
}

Known<Link> linkOf(const PhaseTopic& topic, Sources& sources, const Until& until) {
    Known<Link> link = gatherLink(sources.interfaceName, until);
    const bool aboutJoined =
        topic.subject != Subject::device && topic.subject != Subject::scan && !topic.named;
    if (aboutJoined && link && link->joined && optsOutOfTests(link->joined->says.name)) {
        return failure(Reason::badConfiguration, "the network's name asks not to be looked at (_nomap)");
    }
    return link;
}

Store link(const Facts&, const PhaseTopic& topic, Sources& sources, const Until& until) {
    return [found = linkOf(topic, sources, until)](Facts& into) { into.link = found; };
}

Store nearby(const Facts& facts, const PhaseTopic& topic, Sources& sources, const Until& until) {
    return fromLink(facts, &Facts::nearby, [&](const Link& found) -> Known<std::vector<AccessPoint>> {
        if (!found.up) return failure(Reason::noInterface, found.interfaceName + " is down");
        return sources.scanner.scan({found.interfaceIndex, found.radio, topic.oldestScan, topic.named},
                                    until);
    });
}

Store listened(const Facts& facts, const PhaseTopic& topic, Sources& sources, const Until& until) {
    return fromLink(facts, &Facts::listened, [&](const Link& found) -> Known<std::vector<AccessPoint>> {
        if (!found.up) return failure(Reason::noInterface, found.interfaceName + " is down");
        return sources.scanner.listen({found.interfaceIndex, found.radio, topic.oldestScan, std::nullopt},
                                      until);
    });
}

Store station(const Facts& facts, const PhaseTopic&, Sources&, const Until& until) {
    return fromLink(facts, &Facts::station, [&](const Link& found) { return gatherStation(found, until); });
}

Store survey(const Facts& facts, const PhaseTopic&, Sources&, const Until& until) {
    return fromLink(facts, &Facts::survey, [&](const Link& found) { return gatherSurvey(found, until); });
}

Store regulation(const Facts& facts, const PhaseTopic&, Sources&, const Until& until) {
    return fromLink(facts, &Facts::regulation,
                    [&](const Link& found) { return gatherRegulation(found, until); });
}

Store addresses(const Facts& facts, const PhaseTopic&, Sources&, const Until& until) {
    return fromLink(facts, &Facts::addresses,
                    [&](const Link& found) { return gatherAddresses(found, until); });
}

Store gatewayEcho(const Facts& facts, const PhaseTopic&, Sources& sources, const Until& until) {
    return fromLink(facts, &Facts::gatewayEcho,
                    [&](const Link& found) { return gatherGatewayEcho(found, sources.gatewayEcho, until); });
}

constexpr Fact kLink[] = {Fact::link};
// A scan leaves the channel for a while; echo requests would be lost and delayed meanwhile.
constexpr Fact kPings[] = {Fact::gatewayEcho};
constexpr Fact kPingsAndScan[] = {Fact::gatewayEcho, Fact::nearby};

// clang-format off
constexpr FactRow kRows[] = {
    // fact              needs   after          most  gather
    {Fact::link,         {},     {},            3s,   link},
    {Fact::nearby,       kLink,  kPings,        25s,  nearby},   // a joined radio scans two bands in about 9 s
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
