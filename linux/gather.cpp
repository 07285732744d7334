#include "linux/gather.h"

#include <linux/neighbour.h>
#include <linux/nl80211.h>
#include <linux/rtnetlink.h>
#include <net/if.h>
#include <sys/ioctl.h>
#include <sys/socket.h>

#include <algorithm>
#include <cmath>
#include <filesystem>
#include <map>

#include "linux/files/key_value_file.h"
#include "linux/link_master.h"
#include "linux/reverse_path_filter.h"
#include "linux/route_dump.h"
#include "linux/route_messages.h"
#include "linux/route_query.h"
#include "service/ip_address.h"

namespace wp {
namespace {

using std::chrono::milliseconds;

constexpr int kSignalSamples = 5;
constexpr milliseconds kBetweenSamples{250};
// Counters have steps of about 10 ms: within a second that is one in a hundred.
constexpr milliseconds kCountedTime{1000};
// Counters that stand still for so long are none.
constexpr milliseconds kFirstLook{100};
// While a scan goes on the radio is at home for a fifth of the time. Should that be less, what it counted has to do.
constexpr milliseconds kLongestCount{8000};
constexpr milliseconds kBetweenCounts{20};
// The kernel answers within a few milliseconds.
constexpr milliseconds kShortLook{500};

bool isUp(const std::string& interfaceName) {
    const Descriptor any(socket(AF_INET, SOCK_DGRAM | SOCK_CLOEXEC, 0));
    ifreq request{};
    if (!any || interfaceName.size() >= sizeof request.ifr_name) return false;
    interfaceName.copy(request.ifr_name, interfaceName.size());
    return ioctl(any.number(), SIOCGIFFLAGS, &request) == 0 && (request.ifr_flags & IFF_UP) != 0;
}

/// The one of that name, else the first; nothing where there is none.
std::optional<RadioInterface> chooseInterface(const std::vector<RadioInterface>& stations,
                                              const std::optional<std::string>& wanted) {
    const auto chosen =
        wanted ? std::ranges::find(stations, *wanted, &RadioInterface::name) : stations.begin();
    return chosen == stations.end() ? std::nullopt : std::optional(*chosen);
}

/// What an interface is that joins no networks.
const char* wordOf(std::uint32_t type) {
    switch (type) {
        case NL80211_IFTYPE_AP:
        case NL80211_IFTYPE_AP_VLAN:
            return "an access point";
        case NL80211_IFTYPE_MONITOR:
            return "a monitor";
        case NL80211_IFTYPE_P2P_CLIENT:
        case NL80211_IFTYPE_P2P_GO:
            return "a direct link";
        case NL80211_IFTYPE_MESH_POINT:
            return "a node of a mesh";
        case NL80211_IFTYPE_ADHOC:
            return "part of an ad-hoc network";
        default:
            return "of another kind";
    }
}

/// Waits until the radio has been at home for so long from now on.
Wait waitAtHome(milliseconds wanted, const HomeChannel::Stay& stay, const Until& until) {
    const Clock::duration goal = stay.timeAtHome() + wanted;
    for (;;) {
        const Clock::duration left = goal - stay.timeAtHome();
        if (left <= Clock::duration::zero()) return Wait::ready;
        const Wait wait = waitReadable(-1, until.within(std::max<Clock::duration>(left, kBetweenCounts)));
        if (wait == Wait::stopped || Clock::now() >= until.deadline) return wait;
    }
}

/// Its access point tells whether it has joined: the interface itself does not always name its network.
Use useOf(RadioSocket& radio, const RadioInterface& interface, const Until& until) {
    if (!isUp(interface.name)) return Use::down;
    const Known<std::optional<AccessPoint>> joined = radio.joined(interface.index, until);
    return joined && *joined ? Use::joined : Use::up;
}

Known<std::vector<RadioInterface>> stationInterfaces(RadioSocket& radio, const Until& until) {
    Known<std::vector<RadioInterface>> interfaces = radio.interfaces(until);
    if (!interfaces) return interfaces;
    std::erase_if(*interfaces, [](const RadioInterface& each) { return !each.isStation(); });
    // There is nothing to ask where there is nothing to choose.
    if (interfaces->size() > 1)
        putInUseFirst(*interfaces, [&](const RadioInterface& each) { return useOf(radio, each, until); });
    return interfaces;
}

/// The counters of the joined network's channel, or of none. Only read at home: some drivers have them for the present
/// channel alone.
Known<Airtime> homeCounters(RadioSocket& radio, const Link& link, HomeChannel::Stay& stay,
                            const Until& until) {
    if (stay.begin(until) == Wait::stopped) return waitFailure(Wait::stopped, "airtime");
    Known<Airtime> all = radio.airtime(link.interfaceIndex, until);
    if (all) std::erase_if(*all, [&](auto& each) { return each.frequency != link.joined->frequency; });
    return all;
}

enum class Counting { betweenVisits, undisturbed };

/// What the radio counted, and for how long it was at home meanwhile.
struct Counted {
    Airtime airtime;
    Clock::duration atHome{0};
};

/// Counts until the radio has been at home for as long as is wanted, or time is over.
Known<Counted> countAtHome(RadioSocket& radio, const Link& link, HomeChannel::Stay& stay, milliseconds wanted,
                           Counting how, const Until& until) {
    const Known<Airtime> before = homeCounters(radio, link, stay, until);
    if (!before) return before.error();
    if (before->empty()) return Counted();
    const Clock::duration begin = stay.timeAtHome();
    if (how == Counting::betweenVisits) stay.pause();
    const Wait wait = waitAtHome(wanted, stay, until.within(kLongestCount));
    if (wait == Wait::stopped) return waitFailure(wait, "airtime");
    const Known<Airtime> after = homeCounters(radio, link, stay, until);
    if (!after) return after.error();
    return Counted{airtimeBetween(*before, *after), stay.timeAtHome() - begin};
}

/// Whether the radio has counted for about as long as it was at home. Some drivers begin anew with each scan, and some have
/// one row of counters for all channels.
bool isOfHomeAlone(const Counted& counted) {
    const double expected = std::chrono::duration<double, std::milli>(counted.atHome).count();
    return !counted.airtime.empty() &&
           std::abs(static_cast<double>(counted.airtime[0].time) - expected) <= expected / 2;
}

Error notJoined(const Link& link) {
    if (!link.up) return isDown(link);
    return failure(Reason::notJoined, link.interfaceName + " is not joined to a network");
}

}  // namespace

Known<std::vector<RadioInterface>> gatherStationInterfaces(const Until& until) {
    Known<RadioSocket> radio = RadioSocket::open(until);
    if (!radio) return radio.error();
    return stationInterfaces(*radio, until);
}

Error noStation(const std::vector<RadioInterface>& all, const std::optional<std::string>& wanted) {
    std::string others;
    for (const RadioInterface& each : all)
        if (!each.isStation() && each.name == wanted.value_or(each.name))
            others += (others.empty() ? "" : ", ") + each.name + " is " + wordOf(each.type);
    std::string text = "no Wi-Fi interface" + (wanted ? " named " + *wanted : std::string());
    if (!others.empty()) text += " that joins networks: " + others;
    return failure(Reason::noInterface, text);
}

void putInUseFirst(std::vector<RadioInterface>& interfaces,
                   const std::function<Use(const RadioInterface&)>& useOf) {
    std::map<std::uint32_t, Use> uses;
    for (const RadioInterface& each : interfaces) uses[each.index] = useOf(each);
    std::ranges::stable_sort(interfaces, {}, [&](const RadioInterface& each) { return uses[each.index]; });
}

Known<Link> gatherLink(const std::optional<std::string>& wantedInterface, const Until& until) {
    Known<RadioSocket> radio = RadioSocket::open(until);
    if (!radio) return radio.error();
    const Known<std::vector<RadioInterface>> stations = stationInterfaces(*radio, until);
    if (!stations) return stations.error();
    const std::optional<RadioInterface> chosen = chooseInterface(*stations, wantedInterface);
    if (!chosen) {
        const Known<std::vector<RadioInterface>> all = radio->interfaces(until);
        return noStation(all ? *all : std::vector<RadioInterface>(), wantedInterface);
    }
    Link link{chosen->name, chosen->index, chosen->radio, isUp(chosen->name), std::nullopt};
    if (const auto links = routeDump<ifinfomsg>(RTM_GETLINK, "interfaces", until))
        link.master = readMaster(*links, link.interfaceIndex);
    link.switchedOff = !link.up && isSwitchedOff(link.interfaceName);
    if (!link.up) return link;
    Known<std::optional<AccessPoint>> joined = radio->joined(link.interfaceIndex, until);
    if (!joined) return joined.error();
    link.joined = std::move(*joined);
    return link;
}

Link addressed(const Link& link) {
    Link whole = link;
    if (!link.master) return whole;
    whole.interfaceName = link.master->name;
    whole.interfaceIndex = link.master->index;
    return whole;
}

bool isSwitchedOff(const std::string& interfaceName, const std::string& root) {
    std::error_code failed;
    std::filesystem::directory_iterator each(root + "/sys/class/net/" + interfaceName + "/phy80211", failed);
    for (const std::filesystem::directory_iterator end; !failed && each != end; each.increment(failed)) {
        if (!each->path().filename().string().starts_with("rfkill")) continue;
        for (const char* const kind : {"/soft", "/hard"})
            if (readSmallFile(each->path().string() + kind, 64).value_or("").starts_with("1")) return true;
    }
    return false;
}

bool hasLostNetwork(const Link& link, const Until& until) {
    // What took until the deadline is asked about too.
    const Until shortly{until.stop, Clock::now() + kShortLook};
    Known<RadioSocket> radio = RadioSocket::open(shortly);
    if (!link.joined || !radio) return false;
    const auto joined = radio->joined(link.interfaceIndex, shortly);
    return joined ? !*joined : joined.error().code == static_cast<int>(Reason::noInterface);
}

Error isDown(const Link& link) {
    const char* const why = link.switchedOff ? " is down: Wi-Fi is switched off" : " is down";
    return failure(Reason::noInterface, link.interfaceName + why);
}

Known<Station> gatherStation(const Link& link, const Until& until) {
    if (!link.joined) return notJoined(link);
    Known<RadioSocket> radio = RadioSocket::open(until);
    if (!radio) return radio.error();
    const MacAddress& accessPoint = link.joined->peer();
    Known<Station> station = radio->station(link.interfaceIndex, accessPoint, until);
    for (int sample = 1; station && sample < kSignalSamples; ++sample) {
        if (waitReadable(-1, until.within(kBetweenSamples)) == Wait::stopped) {
            return waitFailure(Wait::stopped, "signal");
        }
        const Known<Station> next = radio->station(link.interfaceIndex, accessPoint, until);
        if (!next) break;  // the link went away meanwhile: what was heard of it stands
        std::ranges::copy(next->signals, std::back_inserter(station->signals));
    }
    return station;
}

Known<Survey> gatherSurvey(const Link& link, const Until& until) {
    Known<RadioSocket> radio = RadioSocket::open(until);
    if (!radio) return radio.error();
    return radio->survey(link.interfaceIndex, until);
}

Known<Airtime> gatherAirtime(const Link& link, HomeChannel::Stay& stay, const Until& until) {
    if (!link.joined) return Airtime();
    Known<RadioSocket> radio = RadioSocket::open(until);
    if (!radio) return radio.error();
    const auto count = [&](milliseconds wanted, Counting how) {
        return countAtHome(*radio, link, stay, wanted, how, until);
    };
    const Known<Counted> first = count(kFirstLook, Counting::undisturbed);
    if (!first) return first.error();
    if (first->airtime.empty() || milliseconds(first->airtime[0].time) < kFirstLook / 2) return Airtime();
    for (const Counting how : {Counting::betweenVisits, Counting::undisturbed}) {
        const Known<Counted> counted = count(kCountedTime, how);
        if (!counted) return counted.error();
        // Somebody else's scans have left too little.
        if (counted->atHome < kCountedTime / 2) break;
        if (how == Counting::undisturbed || isOfHomeAlone(*counted)) return counted->airtime;
    }
    return Airtime();
}

Known<AllowedChannels> gatherAllowedChannels(const Link& link, const Until& until) {
    Known<RadioSocket> radio = RadioSocket::open(until);
    if (!radio) return radio.error();
    const Known<RadioAbilities> abilities = radio->abilities(link.radio, until);
    if (!abilities) return abilities.error();
    return allowedAmong(abilities->channels);
}

AllowedChannels allowedAmong(const std::vector<RadioChannel>& channels) {
    AllowedChannels allowed;
    for (const RadioChannel& each : channels)
        if (!each.disabled && each.carriesNetworks())
            allowed.push_back({each.frequency, each.passive, each.radar});
    return allowed;
}

Known<Regulation> gatherRegulation(const Link& link, const Until& until) {
    Known<RadioSocket> radio = RadioSocket::open(until);
    if (!radio) return radio.error();
    return radio->regulation(link.radio, until);
}

Known<Addresses> gatherAddresses(const Link& link, const Until& until) {
    const auto dump = routeDump<ifaddrmsg>(RTM_GETADDR, "addresses", until);
    if (!dump) return dump.error();
    return readAddresses(*dump, link.interfaceIndex);
}

bool answersAsNeighbour(const Link& link, const std::string& address, const Until& until) {
    const auto dump = routeDump<ndmsg>(RTM_GETNEIGH, "neighbours", until);
    const auto wanted = IPAddress::fromText(address);
    return dump && wanted && isReachable(*dump, link.interfaceIndex, wanted->bytes());
}

Known<Echo> askForEcho(const Link& link, const IPAddress& target, EchoSocket& socket, HomeChannel::Stay& stay,
                       const Until& until) {
    Known<Echo> echo = socket.ask(target, link.interfaceName, link.interfaceIndex, stay, until);
    if (!echo || echo->isAnswered()) return echo;
    const auto dropped = droppedByFilter(link, {target}, until);
    return dropped ? Known<Echo>(*dropped) : echo;
}

Known<Echo> gatherGatewayEcho(const Link& link, EchoSocket& socket, HomeChannel::Stay& stay,
                              const Until& until) {
    if (!link.joined) return notJoined(link);
    const auto ways = gatherWaysOut(link, until);
    if (!ways) return ways.error();
    if (ways->empty()) return failure(Reason::notJoined, link.interfaceName + " has no default route");
    const auto way = std::ranges::find_if(*ways, [](const WayOut& each) { return each.router.has_value(); });
    if (way == ways->end()) return failure(Reason::notJoined, link.interfaceName + kNoRouter);
    return askForEcho(link, *way->router, socket, stay, until);
}

}  // namespace wp
