#include "linux/radio_socket.h"

#include <linux/genetlink.h>
#include <linux/nl80211.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <ctime>

namespace wp {
namespace {

Bytes bytesOf(std::string_view text) {
    return {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()};
}

NetlinkAnswer askForFamily(NetlinkSocket& socket, const Until& until) {
    NetlinkRequest request(GENL_ID_CTRL, 0);
    request.header<genlmsghdr>() = {CTRL_CMD_GETFAMILY, 1, 0};
    request.put(CTRL_ATTR_FAMILY_NAME, bytesOf({NL80211_GENL_NAME, sizeof NL80211_GENL_NAME}));
    return socket.ask(request, until);
}

void putNames(NetlinkRequest& request, const ScanOrder& order) {
    if (order.names.empty() && !order.probeForAll) return;
    nlattr* const list = request.beginNest(NL80211_ATTR_SCAN_SSIDS);
    std::uint16_t number = 1;
    for (const NetworkName& name : order.names) request.put(number++, name.bytes());
    if (order.probeForAll) request.put(number, Bytes());
    request.endNest(list);
}

void putFrequencies(NetlinkRequest& request, const ScanOrder& order) {
    if (order.frequencies.empty()) return;
    nlattr* const list = request.beginNest(NL80211_ATTR_SCAN_FREQUENCIES);
    std::uint16_t number = 1;
    for (const std::uint32_t frequency : order.frequencies) request.put(number++, frequency);
    request.endNest(list);
}

/// Of the channels of 6 GHz a radio that scans by itself then visits those alone on which networks of that band
/// announce themselves, and those that access points of the other bands name (IEEE 802.11ax, 26.17.2.3).
void putFlags(NetlinkRequest& request, const ScanOrder& order) {
    constexpr std::uint32_t k6GHzFrom = 5945;
    const bool visits6GHz =
        std::ranges::any_of(order.frequencies, [](auto each) { return each >= k6GHzFrom; });
    if (visits6GHz) request.put(NL80211_ATTR_SCAN_FLAGS, std::uint32_t{NL80211_SCAN_FLAG_COLOCATED_6GHZ});
}

bool isStart(const ScanEvent& event) {
    return event.kind == ScanEvent::Kind::started;
}

/// What a reader made of an answer, or why there is none.
template <class T>
Known<T> orReason(std::optional<T> read, const std::string& what) {
    if (read) return std::move(*read);
    return failure(Reason::unsupported, "the kernel does not tell " + what);
}

}  // namespace

Error failureOf(int error, const std::string& what) {
    const std::string text = what + ": " + std::strerror(error);
    switch (error) {
        case ECANCELED:
            return failure(Reason::cancelled, "cancelled");
        case ETIME:
            return failure(Reason::timeout, what + ": no answer in time");
        case EPERM:
        case EACCES:
            return failure(Reason::notPermitted, text);
        case ENODEV:
            return failure(Reason::noInterface, what + ": the interface is gone");
        case ENETDOWN:
            return failure(Reason::noInterface, what + ": the interface is down");
        case ERFKILL:
            return failure(Reason::noInterface, what + ": the radio is switched off");
        case EOPNOTSUPP:
            return failure(Reason::unsupported, what + ": the driver cannot");
        default:
            return failure(Reason::unavailable, text);
    }
}

std::int64_t bootMilliseconds() {
    timespec now{};
    clock_gettime(CLOCK_BOOTTIME, &now);
    return std::int64_t{now.tv_sec} * 1000 + now.tv_nsec / 1000000;
}

void putOrder(NetlinkRequest& request, const ScanOrder& order) {
    putNames(request, order);
    putFrequencies(request, order);
    putFlags(request, order);
}

RadioSocket::RadioSocket(NetlinkSocket questions, RadioFamily family)
    : questions_(std::move(questions)), family_(std::move(family)) {}

Known<RadioSocket> RadioSocket::open(const Until& until) {
    Known<NetlinkSocket> questions = NetlinkSocket::open(NETLINK_GENERIC);
    if (!questions) return questions.error();
    const NetlinkAnswer answer = askForFamily(*questions, until);
    if (answer.error == ECANCELED || answer.error == ETIME)
        return failureOf(answer.error, "Wi-Fi of the kernel");
    std::optional<RadioFamily> family = readFamily(answer.messages);
    if (!family) return failure(Reason::noInterface, "the kernel knows no Wi-Fi (nl80211)");
    return RadioSocket(std::move(*questions), std::move(*family));
}

NetlinkAnswer RadioSocket::ask(std::uint8_t command, std::uint16_t flags, std::uint32_t interfaceIndex,
                               const Until& until) {
    NetlinkRequest request(family_.number, flags);
    request.header<genlmsghdr>() = {command, 0, 0};
    if (interfaceIndex != 0) request.put(NL80211_ATTR_IFINDEX, interfaceIndex);
    return questions_.ask(request, until);
}

NetlinkAnswer RadioSocket::askAboutRadio(std::uint8_t command, std::uint32_t radio, const Until& until) {
    NetlinkRequest request(family_.number, NLM_F_DUMP);
    request.header<genlmsghdr>() = {command, 0, 0};
    if (command == NL80211_CMD_GET_WIPHY) {
        // Without this flag the kernel leaves out what does not fit into one message.
        request.put(NL80211_ATTR_SPLIT_WIPHY_DUMP, Bytes());
        request.put(NL80211_ATTR_WIPHY, radio);
    }
    return questions_.ask(request, until);
}

Known<std::vector<RadioInterface>> RadioSocket::interfaces(const Until& until) {
    const NetlinkAnswer answer = ask(NL80211_CMD_GET_INTERFACE, NLM_F_DUMP, 0, until);
    if (answer.error != 0) return failureOf(answer.error, "interfaces");
    return readInterfaces(answer.messages);
}

Known<std::vector<AccessPoint>> RadioSocket::accessPoints(std::uint32_t interfaceIndex, const Until& until) {
    const NetlinkAnswer answer = ask(NL80211_CMD_GET_SCAN, NLM_F_DUMP, interfaceIndex, until);
    if (answer.error != 0) return failureOf(answer.error, "scan results");
    return readAccessPoints(answer.messages, bootMilliseconds());
}

Known<std::optional<AccessPoint>> RadioSocket::joined(std::uint32_t interfaceIndex, const Until& until) {
    Known<std::vector<AccessPoint>> known = accessPoints(interfaceIndex, until);
    if (!known) return known.error();
    std::optional<AccessPoint> joined;
    for (AccessPoint& each : *known)
        if (each.joined && (!joined || each.signal > joined->signal)) joined = std::move(each);
    return joined;
}

/// Some drivers list no links, and some list those to other stations too; a few only list.
Known<Station> RadioSocket::station(std::uint32_t interfaceIndex, const MacAddress& accessPoint,
                                    const Until& until) {
    NetlinkRequest request(family_.number, 0);
    request.header<genlmsghdr>() = {NL80211_CMD_GET_STATION, 0, 0};
    request.put(NL80211_ATTR_IFINDEX, interfaceIndex);
    request.put(NL80211_ATTR_MAC, accessPoint);
    NetlinkAnswer answer = questions_.ask(request, until);
    if (answer.error == EOPNOTSUPP) answer = ask(NL80211_CMD_GET_STATION, NLM_F_DUMP, interfaceIndex, until);
    if (answer.error == ENOENT) return failure(Reason::notJoined, "no longer joined to the access point");
    if (answer.error != 0) return failureOf(answer.error, "link");
    std::optional<Station> station = readStation(answer.messages);
    if (!station) return failure(Reason::notJoined, "not joined to a network");
    return std::move(*station);
}

Known<Survey> RadioSocket::survey(std::uint32_t interfaceIndex, const Until& until) {
    const NetlinkAnswer answer = ask(NL80211_CMD_GET_SURVEY, NLM_F_DUMP, interfaceIndex, until);
    if (answer.error != 0) return failureOf(answer.error, "survey");
    return readSurvey(answer.messages);
}

Known<Airtime> RadioSocket::airtime(std::uint32_t interfaceIndex, const Until& until) {
    const NetlinkAnswer answer = ask(NL80211_CMD_GET_SURVEY, NLM_F_DUMP, interfaceIndex, until);
    if (answer.error != 0) return failureOf(answer.error, "survey");
    return readAirtime(answer.messages);
}

Known<Regulation> RadioSocket::regulation(std::uint32_t radio, const Until& until) {
    const NetlinkAnswer answer = askAboutRadio(NL80211_CMD_GET_REG, radio, until);
    if (answer.error != 0) return failureOf(answer.error, "regulatory domain");
    return orReason(readRegulation(answer.messages, radio), "the regulatory domain");
}

Known<RadioAbilities> RadioSocket::abilities(std::uint32_t radio, const Until& until) {
    const NetlinkAnswer answer = askAboutRadio(NL80211_CMD_GET_WIPHY, radio, until);
    if (answer.error != 0) return failureOf(answer.error, "radio");
    return orReason(readAbilities(answer.messages, radio), "what the radio can do");
}

int RadioSocket::startScan(std::uint32_t interfaceIndex, const ScanOrder& order, const Until& until) {
    NetlinkRequest request(family_.number, 0);
    request.header<genlmsghdr>() = {NL80211_CMD_TRIGGER_SCAN, 0, 0};
    request.put(NL80211_ATTR_IFINDEX, interfaceIndex);
    putOrder(request, order);
    receiveWaitingEvents();
    arrived_.clear();
    const int error = questions_.ask(request, until).error;
    if (error != 0) return error;
    // The kernel announces a start before it acknowledges it. What lies before it is of a scan that ended just then.
    receiveWaitingEvents();
    forgetEventsBeforeTheLatestStart(interfaceIndex);
    return 0;
}

void RadioSocket::receiveWaitingEvents() {
    while (events_) {
        const NetlinkAnswer answer = events_->receiveWaiting();
        if (answer.error != 0 && answer.error != ENOBUFS) return;
        std::ranges::move(readScanEvents(answer.messages), std::back_inserter(arrived_));
    }
}

void RadioSocket::forgetEventsBeforeTheLatestStart(std::uint32_t interfaceIndex) {
    const auto latest = std::find_if(arrived_.rbegin(), arrived_.rend(), [&](const ScanEvent& each) {
        return each.interfaceIndex == interfaceIndex && isStart(each);
    });
    if (latest != arrived_.rend()) arrived_.erase(arrived_.begin(), latest.base());
}

void RadioSocket::abortScan(std::uint32_t interfaceIndex) {
    // The run is over: a kernel that does not answer at once is not waited for.
    const Until shortly{std::make_shared<StopSignal>(), Clock::now() + std::chrono::milliseconds(50)};
    ask(NL80211_CMD_ABORT_SCAN, 0, interfaceIndex, shortly);
}

bool RadioSocket::listenForScans() {
    const auto group = family_.groups.find(NL80211_MULTICAST_GROUP_SCAN);
    Known<NetlinkSocket> events = NetlinkSocket::open(NETLINK_GENERIC);
    if (!events || group == family_.groups.end() || !events->join(group->second)) return false;
    events_ = std::move(*events);
    return true;
}

Known<ScanEvent> RadioSocket::nextScanStart(std::uint32_t interfaceIndex, const Until& until) {
    return nextScanEvent(
        [=](const ScanEvent& each) { return each.interfaceIndex == interfaceIndex && isStart(each); }, until);
}

Known<ScanEvent> RadioSocket::nextScanEnd(std::uint32_t interfaceIndex, const Until& until) {
    return nextScanEvent(
        [=](const ScanEvent& each) { return each.interfaceIndex == interfaceIndex && !isStart(each); },
        until);
}

Known<ScanEvent> RadioSocket::nextScanEndOfRadio(std::uint32_t radio, const Until& until) {
    return nextScanEvent([=](const ScanEvent& each) { return each.radio == radio && !isStart(each); }, until);
}

Known<ScanEvent> RadioSocket::nextScanEvent(const std::function<bool(const ScanEvent&)>& isWanted,
                                            const Until& until) {
    for (;;) {
        while (!arrived_.empty()) {
            const ScanEvent event = arrived_.front();
            arrived_.pop_front();
            if (isWanted(event)) return event;
        }
        const NetlinkAnswer answer = events_->receive(until);
        // Too many messages at once: some are lost, and the end of a scan may be among them.
        if (answer.error == ENOBUFS) continue;
        if (answer.error != 0) return failureOf(answer.error, "scan");
        std::ranges::move(readScanEvents(answer.messages), std::back_inserter(arrived_));
    }
}

}  // namespace wp
