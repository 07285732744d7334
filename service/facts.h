#pragma once

#include <algorithm>
#include <optional>
#include <string>
#include <vector>

#include "service/access_point.h"
#include "service/known.h"
#include "service/link_setup.h"
#include "service/peer_link.h"
#include "service/settings.h"

namespace wp {

/// The bridge or bond that an interface is part of.
struct LinkMaster {
    std::string name;
    std::uint32_t index = 0;
    bool sendsElsewhere =
        false;  ///< the interface only stands by: what is sent over the whole leaves by another part
    friend bool operator==(const LinkMaster&, const LinkMaster&) = default;
};

/// The Wi-Fi interface that is looked at, and what it is joined to.
struct Link {
    std::string interfaceName;
    std::uint32_t interfaceIndex = 0;
    std::uint32_t radio = 0;  ///< the kernel's number of the radio
    bool up = false;
    std::optional<AccessPoint> joined;  ///< the access point, as the kernel keeps it up to date
    /// What has addresses and routes in the interface's place; absent where it has them itself.
    std::optional<LinkMaster> master{};
    bool switchedOff = false;  ///< its radio, which is why it is down
};

/// What the driver says of the link to the joined access point.
struct Station {
    std::vector<int> signals;                     ///< dBm, several within a second
    std::optional<std::uint8_t> dtimPeriod;       ///< in beacons
    std::optional<std::uint16_t> beaconInterval;  ///< in units of 1.024 ms
};

/// One channel of a survey.
struct SurveyedChannel {
    std::uint32_t frequency = 0;  ///< MHz
    bool inUse = false;
    std::optional<int> noise;  ///< dBm, only where the radio measures it
};
using Survey = std::vector<SurveyedChannel>;

/// The regulatory domain in use on the radio.
struct Regulation {
    std::string country;  ///< two letters, or "00", "99", "98" for a world-wide or combined one
};

/// One address of the interface.
struct Address {
    enum class Family { ipv4, ipv6 };
    Family family = Family::ipv4;
    std::vector<std::uint8_t> bytes;  ///< 4 or 16
    bool global = false;              ///< of universal scope
    /// Neither being checked for duplicates nor found to be one, and not deprecated (IPv6).
    bool usable = true;
};
using Addresses = std::vector<Address>;

/// The answers to a row of echo requests.
struct Echo {
    std::string interfaceName;
    std::string target;                             ///< for the log
    std::vector<std::optional<double>> roundTrips;  ///< ms, one for each request; absent: no answer
    double startedAt = 0;                           ///< seconds since 2001-01-01 00:00:00 UTC

    /// Whether any request was answered.
    bool isAnswered() const {
        return std::ranges::any_of(roundTrips, [](const auto& each) { return each.has_value(); });
    }
};

/// All that the tests of one phase go by. What was not gathered, or could not be, says why.
struct Facts {
    std::optional<NetworkName> named;  ///< the network asked about; absent: the one that is joined
    Known<Link> link;
    Known<std::vector<AccessPoint>> nearby;    ///< all access points of the scan, the joined one included
    Known<std::vector<AccessPoint>> listened;  ///< what beacons tell that a scan is too short to hear
    Known<Station> station;
    Known<Survey> survey;
    Known<Regulation> regulation;
    Known<Addresses> addresses;
    Known<Echo> gatewayEcho;
    Known<LinkSetup> setup;
    Known<SavedNetworks> saved;
    Known<Bluetooth> bluetooth;
    Known<bool> driverSharesAirtime;
    Known<PeerLinks> peerLinks;
    Known<Airtime> airtime;
    Known<AllowedChannels> allowedChannels;
    Known<Echo> outsideEcho;
    Known<NameAnswer> nameAnswer;
    Known<PortalEvidence> portal;
    Known<VendorContacts> vendorService;
    Known<RouterAnswers> router;
    Known<TranslationEvidence> translation;
    Settings settings;  ///< not gathered, but set before all others
};

/// The kinds of facts, to say which ones a test needs. `judged` stands for where the judged access point is
/// found: `link` for the joined network, `nearby` for a named one.
enum class Fact {
    judged,
    link,
    nearby,
    listened,
    station,
    survey,
    regulation,
    addresses,
    gatewayEcho,
    setup,
    saved,
    bluetooth,
    driverSharesAirtime,
    peerLinks,
    airtime,
    allowedChannels,
    outsideEcho,
    nameAnswer,
    portal,
    vendorService,
    router,
    translation,
};
constexpr std::size_t kFactCount = static_cast<std::size_t>(Fact::translation) + 1;

}  // namespace wp
