#include "linux/radio_messages.h"

#include <linux/genetlink.h>
#include <linux/nl80211.h>

#include <algorithm>

namespace wp {
namespace {

/// Calls `visit(attributes)` for each message of the command.
template <class Visit>
void forEachOf(std::uint8_t command, Bytes buffer, Visit visit) {
    forEachContent(buffer, [&](const NetlinkMessage& message) {
        if (message.payload.size() < GENL_HDRLEN || message.payload[0] != command) return;
        visit(message.attributesAfter(GENL_HDRLEN));
    });
}

/// Calls `visit(frequency, information)` for each channel of a survey.
template <class Visit>
void forEachSurveyed(Bytes buffer, Visit visit) {
    forEachOf(NL80211_CMD_NEW_SURVEY_RESULTS, buffer, [&](const Attributes& message) {
        const Attributes info = message.nested(NL80211_ATTR_SURVEY_INFO);
        if (const auto frequency = info.number<std::uint32_t>(NL80211_SURVEY_INFO_FREQUENCY))
            visit(*frequency, info);
    });
}

std::optional<MacAddress> addressIn(std::optional<Bytes> content) {
    MacAddress address;
    if (!content || content->size() != address.size()) return std::nullopt;
    std::ranges::copy(*content, address.begin());
    return address;
}

std::int64_t toMilliseconds(std::uint64_t nanoseconds) {
    return static_cast<std::int64_t>(nanoseconds / 1000000);
}

std::optional<std::int64_t> lastSeen(const Attributes& bss, std::int64_t now) {
    if (const auto at = bss.number<std::uint64_t>(NL80211_BSS_LAST_SEEN_BOOTTIME)) return toMilliseconds(*at);
    if (const auto ago = bss.number<std::uint32_t>(NL80211_BSS_SEEN_MS_AGO)) return now - *ago;
    return std::nullopt;
}

std::optional<int> signalOf(const Attributes& bss) {
    const auto hundredths = bss.number<std::int32_t>(NL80211_BSS_SIGNAL_MBM);
    if (!hundredths) return std::nullopt;
    return *hundredths / 100;
}

/// The elements of a beacon. Drivers whose firmware scans hand frames over without saying of what kind they are, and no
/// flag then tells a probe response: only beacons carry a traffic map (IEEE 802.11-2020, 9.3.3.2 and 9.3.3.10).
std::optional<Bytes> beaconOf(const Attributes& bss, Bytes latest) {
    if (const std::optional<Bytes> beacon = bss.find(NL80211_BSS_BEACON_IES)) return beacon;
    if (bss.has(NL80211_BSS_PRESP_DATA) || !decodeElements(latest).trafficMap.present()) return std::nullopt;
    return latest;
}

std::optional<AccessPoint> accessPointOf(const Attributes& bss, std::int64_t now) {
    constexpr std::uint16_t kOfAccessPoint = 1;  // the capability bit ESS
    const std::optional<MacAddress> address = addressIn(bss.find(NL80211_BSS_BSSID));
    if (!address) return std::nullopt;
    const Bytes latest = bss.find(NL80211_BSS_INFORMATION_ELEMENTS).value_or(Bytes());
    const std::optional<Bytes> beacon = beaconOf(bss, latest);

    AccessPoint accessPoint;
    accessPoint.address = *address;
    accessPoint.frequency = bss.number<std::uint32_t>(NL80211_BSS_FREQUENCY).value_or(0);
    accessPoint.beaconInterval = bss.number<std::uint16_t>(NL80211_BSS_BEACON_INTERVAL);
    accessPoint.capability = bss.number<std::uint16_t>(NL80211_BSS_CAPABILITY).value_or(0);
    accessPoint.directOnly =
        (bss.number<std::uint16_t>(NL80211_BSS_CAPABILITY).value_or(kOfAccessPoint) & kOfAccessPoint) == 0;
    accessPoint.signal = signalOf(bss);
    accessPoint.lastSeen = lastSeen(bss, now);
    accessPoint.joined =
        bss.number<std::uint32_t>(NL80211_BSS_STATUS) == std::uint32_t{NL80211_BSS_STATUS_ASSOCIATED};
    accessPoint.multiLinkAddress = addressIn(bss.find(NL80211_BSS_MLD_ADDR));
    accessPoint.elements.assign(latest.begin(), latest.end());
    if (beacon) accessPoint.beaconElements.emplace(beacon->begin(), beacon->end());
    accessPoint.says = decodeAdvertised(accessPoint.capability, latest, beacon);
    return accessPoint;
}

/// Of an access point that hides the kernel leaves beacon and answer apart where the driver does not say which is which.
void completeByBeacons(std::vector<AccessPoint>& accessPoints) {
    for (AccessPoint& each : accessPoints) {
        if (each.beaconElements || each.says.name.absent()) continue;
        const auto beacon = std::ranges::find_if(accessPoints, [&](const AccessPoint& other) {
            return other.address == each.address && other.frequency == each.frequency &&
                   other.says.name.absent() && other.beaconElements;
        });
        if (beacon == accessPoints.end()) continue;
        each.beaconElements = beacon->beaconElements;
        each.says = decodeAdvertised(each.capability, each.elements, Bytes(*each.beaconElements));
    }
}

/// The first of several ways in which drivers tell the signal.
std::optional<int> stationSignal(const Attributes& station) {
    for (const std::uint16_t type :
         {NL80211_STA_INFO_SIGNAL_AVG, NL80211_STA_INFO_SIGNAL, NL80211_STA_INFO_BEACON_SIGNAL_AVG}) {
        // One that was not measured is named all the same: that of a link which is one of several, for one.
        if (const auto signal = station.number<std::int8_t>(type); signal && isLevel(*signal)) return *signal;
    }
    return std::nullopt;
}

RadioChannel channelOf(const Attributes& frequency) {
    return {frequency.number<std::uint32_t>(NL80211_FREQUENCY_ATTR_FREQ).value_or(0),
            frequency.has(NL80211_FREQUENCY_ATTR_DISABLED), frequency.has(NL80211_FREQUENCY_ATTR_NO_IR),
            frequency.has(NL80211_FREQUENCY_ATTR_RADAR), frequency.has(NL80211_FREQUENCY_ATTR_NO_20MHZ)};
}

void addChannels(std::vector<RadioChannel>& channels, const Attributes& bands) {
    bands.forEach([&](std::uint16_t, Bytes band) {
        Attributes(band).nested(NL80211_BAND_ATTR_FREQS).forEach([&](std::uint16_t, Bytes frequency) {
            const RadioChannel channel = channelOf(Attributes(frequency));
            if (channel.frequency != 0) channels.push_back(channel);
        });
    });
}

/// mac80211 claims both on behalf of drivers that cannot scan by themselves, and no other driver claims both.
bool scansInSoftware(std::uint32_t features) {
    constexpr std::uint32_t kInSoftware = NL80211_FEATURE_LOW_PRIORITY_SCAN | NL80211_FEATURE_AP_SCAN;
    return (features & kInSoftware) == kInSoftware;
}

std::vector<std::uint32_t> numbersOf(const Attributes& list) {
    std::vector<std::uint32_t> numbers;
    list.forEach([&](std::uint16_t, Bytes content) {
        if (const auto number = Attributes::numberIn<std::uint32_t>(content)) numbers.push_back(*number);
    });
    return numbers;
}

std::optional<ScanEvent::Kind> scanEventKind(Bytes payload) {
    if (payload.size() < GENL_HDRLEN) return std::nullopt;
    switch (payload[0]) {
        case NL80211_CMD_TRIGGER_SCAN:
            return ScanEvent::Kind::started;
        case NL80211_CMD_NEW_SCAN_RESULTS:
            return ScanEvent::Kind::finished;
        case NL80211_CMD_SCAN_ABORTED:
            return ScanEvent::Kind::aborted;
        default:
            return std::nullopt;
    }
}

void addScanEvent(std::vector<ScanEvent>& events, ScanEvent::Kind kind, const Attributes& message) {
    const auto radio = message.number<std::uint32_t>(NL80211_ATTR_WIPHY);
    if (!radio) return;
    ScanEvent event{kind, message.number<std::uint32_t>(NL80211_ATTR_IFINDEX).value_or(0),
                    numbersOf(message.nested(NL80211_ATTR_SCAN_FREQUENCIES)), false, *radio};
    message.nested(NL80211_ATTR_SCAN_SSIDS).forEach([&](std::uint16_t, Bytes name) {
        if (name.empty()) event.probedForAll = true;
    });
    events.push_back(event);
}

}  // namespace

bool RadioInterface::isStation() const {
    return type == NL80211_IFTYPE_STATION;
}

bool RadioChannel::carriesNetworks() const {
    constexpr std::uint32_t kMetersUntil = 1000, kVehiclesFrom = 5850, kVehiclesUntil = 5925,
                            kChannel149 = 5745, kChannel0 = 5000;
    if (narrow || (bandOf(frequency) == Band::ghz5 && frequency < kChannel0)) return false;
    if (frequency < kVehiclesFrom || frequency > kVehiclesUntil) return frequency > kMetersUntil;
    return (frequency - kChannel149) % 20 == 0;
}

bool RadioChannel::isForScanning() const {
    constexpr std::uint32_t k6GHzFrom = 5945, kChannel5 = 5975;
    return frequency < k6GHzFrom || (frequency >= kChannel5 && (frequency - kChannel5) % 80 == 0);
}

std::optional<RadioFamily> readFamily(Bytes buffer) {
    std::optional<RadioFamily> family;
    forEachOf(CTRL_CMD_NEWFAMILY, buffer, [&](const Attributes& message) {
        const auto number = message.number<std::uint16_t>(CTRL_ATTR_FAMILY_ID);
        if (!number || message.text(CTRL_ATTR_FAMILY_NAME) != NL80211_GENL_NAME) return;
        family = RadioFamily{*number, {}};
        message.nested(CTRL_ATTR_MCAST_GROUPS).forEach([&](std::uint16_t, Bytes content) {
            const Attributes group(content);
            const auto id = group.number<std::uint32_t>(CTRL_ATTR_MCAST_GRP_ID);
            if (const auto name = group.text(CTRL_ATTR_MCAST_GRP_NAME); id && name)
                family->groups[*name] = *id;
        });
    });
    return family;
}

std::vector<RadioInterface> readInterfaces(Bytes buffer) {
    std::vector<RadioInterface> interfaces;
    forEachOf(NL80211_CMD_NEW_INTERFACE, buffer, [&](const Attributes& message) {
        const auto name = message.text(NL80211_ATTR_IFNAME);
        const auto index = message.number<std::uint32_t>(NL80211_ATTR_IFINDEX);
        if (!name || !index) return;  // a peer-to-peer device has neither
        RadioInterface interface;
        interface.name = *name;
        interface.index = *index;
        interface.radio = message.number<std::uint32_t>(NL80211_ATTR_WIPHY).value_or(0);
        interface.type = message.number<std::uint32_t>(NL80211_ATTR_IFTYPE).value_or(0);
        interface.frequency = message.number<std::uint32_t>(NL80211_ATTR_WIPHY_FREQ);
        interfaces.push_back(std::move(interface));
    });
    return interfaces;
}

std::vector<AccessPoint> readAccessPoints(Bytes buffer, std::int64_t now) {
    std::vector<AccessPoint> accessPoints;
    forEachOf(NL80211_CMD_NEW_SCAN_RESULTS, buffer, [&](const Attributes& message) {
        std::optional<AccessPoint> each = accessPointOf(message.nested(NL80211_ATTR_BSS), now);
        if (each) accessPoints.push_back(std::move(*each));
    });
    completeByBeacons(accessPoints);
    return accessPoints;
}

std::optional<Station> readStation(Bytes buffer) {
    std::optional<Station> station;
    forEachOf(NL80211_CMD_NEW_STATION, buffer, [&](const Attributes& message) {
        if (station) return;
        const Attributes info = message.nested(NL80211_ATTR_STA_INFO);
        const Attributes parameters = info.nested(NL80211_STA_INFO_BSS_PARAM);
        station.emplace();
        if (const auto signal = stationSignal(info)) station->signals.push_back(*signal);
        station->dtimPeriod = parameters.number<std::uint8_t>(NL80211_STA_BSS_PARAM_DTIM_PERIOD);
        station->beaconInterval = parameters.number<std::uint16_t>(NL80211_STA_BSS_PARAM_BEACON_INTERVAL);
    });
    return station;
}

Survey readSurvey(Bytes buffer) {
    Survey survey;
    forEachSurveyed(buffer, [&](std::uint32_t frequency, const Attributes& info) {
        SurveyedChannel channel{frequency, info.has(NL80211_SURVEY_INFO_IN_USE), std::nullopt};
        if (const auto noise = info.number<std::int8_t>(NL80211_SURVEY_INFO_NOISE)) channel.noise = *noise;
        survey.push_back(channel);
    });
    return survey;
}

Airtime readAirtime(Bytes buffer) {
    Airtime airtime;
    forEachSurveyed(buffer, [&](std::uint32_t frequency, const Attributes& info) {
        const auto time = info.number<std::uint64_t>(NL80211_SURVEY_INFO_TIME);
        if (!time) return;
        ChannelTime channel;
        channel.frequency = frequency;
        channel.inUse = info.has(NL80211_SURVEY_INFO_IN_USE);
        channel.time = *time;
        channel.busy = info.number<std::uint64_t>(NL80211_SURVEY_INFO_TIME_BUSY);
        channel.transmit = info.number<std::uint64_t>(NL80211_SURVEY_INFO_TIME_TX).value_or(0);
        channel.receiveOwn = info.number<std::uint64_t>(NL80211_SURVEY_INFO_TIME_BSS_RX).value_or(0);
        if (const auto noise = info.number<std::int8_t>(NL80211_SURVEY_INFO_NOISE)) channel.noise = *noise;
        airtime.push_back(channel);
    });
    return airtime;
}

std::optional<Regulation> readRegulation(Bytes buffer, std::uint32_t radio) {
    std::optional<Regulation> system;
    std::optional<Regulation> own;
    bool managesItself = false;
    forEachOf(NL80211_CMD_GET_REG, buffer, [&](const Attributes& message) {
        const auto country = message.text(NL80211_ATTR_REG_ALPHA2);
        if (!country || country->size() != 2) return;
        const auto of = message.number<std::uint32_t>(NL80211_ATTR_WIPHY);
        if (!of) system = Regulation{*country};
        if (of != radio) return;
        own = Regulation{*country};
        managesItself = message.has(NL80211_ATTR_WIPHY_SELF_MANAGED_REG);
    });
    // Some drivers tell what their radio allows at most under a number; which country holds the system then says.
    const bool isNumber = own && own->country[0] >= '0' && own->country[0] <= '9';
    return own && (managesItself || !isNumber || !system) ? own : system;
}

std::optional<RadioAbilities> readAbilities(Bytes buffer, std::uint32_t radio) {
    std::optional<RadioAbilities> abilities;
    // A radio is told in many messages: each adds to what the others said.
    forEachOf(NL80211_CMD_NEW_WIPHY, buffer, [&](const Attributes& message) {
        if (message.number<std::uint32_t>(NL80211_ATTR_WIPHY) != radio) return;
        if (!abilities) abilities.emplace();
        if (const auto names = message.number<std::uint8_t>(NL80211_ATTR_MAX_NUM_SCAN_SSIDS)) {
            abilities->namesPerScan = *names;
        }
        if (const auto features = message.number<std::uint32_t>(NL80211_ATTR_FEATURE_FLAGS)) {
            abilities->scansInSoftware = scansInSoftware(*features);
        }
        addChannels(abilities->channels, message.nested(NL80211_ATTR_WIPHY_BANDS));
    });
    return abilities;
}

std::vector<ScanEvent> readScanEvents(Bytes buffer) {
    std::vector<ScanEvent> events;
    forEachContent(buffer, [&](const NetlinkMessage& message) {
        const std::optional<ScanEvent::Kind> kind = scanEventKind(message.payload);
        if (kind) addScanEvent(events, *kind, message.attributesAfter(GENL_HDRLEN));
    });
    return events;
}

}  // namespace wp
