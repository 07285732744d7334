#include <gtest/gtest.h>

#include "platform/json_writer.h"
#include "service/answer.h"
#include "service/channel_use.h"
#include "verification/unit/service/addresses.h"
#include "verification/unit/service/frames.h"
#include "verification/unit/service/portal_answers.h"

namespace wp {
namespace {

/// The details of the test's answer; empty where it has none.
Details detailsOf(int number, const Facts& facts) {
    const DiagnosticsTestResponse response = answerOf(*findTest(number), facts);
    if (!response.results || response.results->front()->info == nullptr) return {};
    const auto details = response.results->front()->info->value("Details");
    return details ? (*details->as<DictionaryPointer>())->entries() : Details();
}

/// One entry of the details as JSON; empty where there is none.
std::string detail(int number, const Facts& facts, std::string_view key) {
    const Details details = detailsOf(number, facts);
    const auto found = details.find(key);
    return found == details.end() ? "" : jsonText(found->second, JSONStyle::compact);
}

Facts withPortal(PortalAnswer plain, PortalAnswer secure) {
    Facts facts = joinedTo({heard(nameElement("Cafe"))});
    facts.portal = PortalEvidence{{}, std::move(plain), std::move(secure)};
    facts.saved = SavedNetworks{"store", {}};
    return facts;
}

TEST(Answer, KeepsTheVerdictsOwnInformationAsItIs) {
    const Facts facts = joinedTo({heard(nameElement("Northlight"))});

    const auto response = answerOf(*findTest(34), facts);

    ASSERT_TRUE(response.results);
    const DiagnosticsTestResult& result = *response.results->front();
    EXPECT_FALSE(response.error);
    EXPECT_TRUE(result.didPass);
    EXPECT_EQ(jsonText(result.info, JSONStyle::compact),
              R"({"BeaconInterval":100,"Details":{"Thresholds":{"beaconInterval":110}}})");
}

TEST(Answer, HasNoInformationWhereNothingWasMeasured) {
    Facts facts;
    facts.setup = LinkSetup();
    facts.setup->proxies = WebProxyPlaces();

    const auto response = answerOf(*findTest(17), facts);

    ASSERT_TRUE(response.results);
    EXPECT_EQ(response.results->front()->info, nullptr);
}

TEST(Answer, OfATestThatCannotTellCarriesWhatWasMeasuredAndTheReasonBesideTheError) {
    Facts facts = joinedTo({heard(nameElement("Northlight"))});
    ServiceContact contact;
    contact.end = ServiceContact::End::badCertificate;
    contact.fault = CertificateFault::notYetValid;
    contact.why = "certificate";
    facts.vendorService = VendorContacts{contact, contact, {true}};
    PortalAnswer plain = answered(204);
    plain.clockOffset = -90000;
    facts.portal = PortalEvidence{{}, plain, {}};

    const auto response = answerOf(*findTest(9), facts);

    ASSERT_TRUE(response.error && response.results);
    EXPECT_EQ(response.error->code, 9);
    EXPECT_EQ(detail(9, facts, "reason"), R"("badConfiguration")");
    EXPECT_EQ(detail(9, facts, "certificateFault"), R"("notYetValid")");
    EXPECT_EQ(detail(9, facts, "clockOffset"), "-90000");
    EXPECT_EQ(detail(9, facts, "clockSource"), R"("portalProbe")");
    EXPECT_EQ(detail(9, facts, "clockBeforeBuild"), "true");
}

TEST(Answer, OfATestThatCouldMeasureNothingIsTheErrorAlone) {
    const auto response = answerOf(*findTest(34), Facts());

    EXPECT_TRUE(response.error);
    EXPECT_FALSE(response.results);
}

TEST(Details, OfAPingAreItsTimesWithNullForALostOne) {
    Facts facts;
    facts.gatewayEcho = Echo{"wlan0", "10.0.0.1", {1.68049, std::nullopt, 2.0}, 0};

    EXPECT_EQ(detail(3, facts, "roundTripTimes"), "[1.68,null,2.0]");
    EXPECT_EQ(detail(3, facts, "target"), R"("10.0.0.1")");
}

TEST(Details, OfNamesTellEachServerApart) {
    Facts facts;
    facts.nameAnswer = NameAnswer{
        "example.com",
        {address("203.0.113.7")},
        "",
        std::chrono::milliseconds(18),
        {{address("10.0.0.1"), "NOERROR", true, 18.25}, {address("10.0.0.2"), "timeout", false, 2000}}};

    EXPECT_EQ(detail(7, facts, "servers"),
              R"([{"address":"10.0.0.1","answered":true,"code":"NOERROR","time":18.25},)"
              R"({"address":"10.0.0.2","answered":false,"code":"timeout","time":2000.0}])");
    EXPECT_EQ(detail(7, facts, "time"), "18");
    EXPECT_EQ(detail(7, facts, "Thresholds"), R"({"slowTime":400,"verySlowTime":500})");
}

TEST(Details, OfTheServiceAreItsStepsAndItsOwnClockBeforeThePortals) {
    Facts facts;
    ServiceContact contact;
    contact.end = ServiceContact::End::reached;
    contact.status = 204;
    contact.steps = {12.5, 20.0, std::nullopt};
    contact.clockOffset = 2;
    facts.vendorService = VendorContacts{contact, contact, {}};
    PortalAnswer plain = answered(204);
    plain.clockOffset = -90000;
    facts.portal = PortalEvidence{{}, plain, {}};

    EXPECT_EQ(jsonText(Dictionary::make(detailsOf(11, facts)), JSONStyle::compact),
              R"({"clockBeforeBuild":false,"clockOffset":2,"clockSource":"service","connectTime":12.5,)"
              R"("end":"reached","secureTime":20.0,"status":204})");

    facts.vendorService->retrieve->why = "the connection was closed";
    EXPECT_EQ(detail(11, facts, "why"), R"("the connection was closed")") << "before the content was whole";
}

TEST(Details, OfAPortalAreItsKindItsPageAndTheReach) {
    const Facts redirect = withPortal(answered(302, 0, "http://login.example/"), {});
    EXPECT_EQ(detail(46, redirect, "kind"), R"("redirect")");
    EXPECT_EQ(detail(46, redirect, "url"), R"("http://login.example/")");
    EXPECT_EQ(detail(46, redirect, "connectivity"), R"("portal")");

    const Facts declared = [] {
        Facts facts = withPortal(answered(204), {});
        facts.portal->declared = {false, true, "https://login.example/"};
        return facts;
    }();
    EXPECT_EQ(detail(46, declared, "kind"), R"("declared")");
    EXPECT_EQ(detail(46, declared, "url"), R"("https://login.example/")");

    Facts tooLong = declared;
    tooLong.portal->declared.page.clear();
    EXPECT_EQ(detail(46, tooLong, "kind"), R"("declared")");
    EXPECT_EQ(detail(46, tooLong, "url"), "");
    EXPECT_EQ(detail(46, tooLong, "why"),
              R"("the network's own API says so; the address of its page is too long to tell")");

    EXPECT_EQ(detail(46, withPortal(answered(511), {}), "kind"), R"("status511")");
    EXPECT_EQ(detail(46, withPortal(answered(200, 300), {}), "kind"), R"("alteredPage")");
    EXPECT_EQ(detail(46, withPortal(answered(204), {}), "kind"), R"("none")");
}

TEST(Details, TellHowFarTheNetworkReaches) {
    const PortalAnswer silent;
    const PortalAnswer open = answered(204);
    PortalAnswer untold;
    untold.end = PortalAnswer::End::untold;
    const std::tuple<PortalAnswer, PortalAnswer, const char*> rows[] = {
        {open, open, R"("full")"},
        {open, silent, R"("partial")"},
        {open, untold, ""},
        {silent, untold, ""},
        {answered(302), untold, R"("portal")"},
        {answered(200, 1), open, R"("full")"},
        {silent, open, R"("partial")"},
        {answered(200, 0), silent, R"("partial")"},
        {answered(500, 9), open, R"("partial")"},
        {silent, silent, R"("none")"},
        {answered(302), open, R"("portal")"},
        {answered(500, 9), silent, ""},
    };
    for (const auto& [plain, secure, expected] : rows)
        EXPECT_EQ(detail(46, withPortal(plain, secure), "connectivity"), expected) << plain.status;
}

TEST(Details, OfTheAirListEveryNetworkWithItsWidth) {
    AccessPoint own = heard(nameElement("Northlight") + element(192, {1, 42, 0, 0, 0}), 5180, -52);
    own.says.load = 51;
    AccessPoint hidden = heard(nameElement("") + element(61, {1, 1}), 2412, -70);
    hidden.signal.reset();
    Facts facts = joinedTo({own, hidden});
    facts.allowedChannels = AllowedChannels{{2412, false, false}, {5260, true, true}};
    facts.nearby->at(0).address = facts.link->joined->address = {2, 0, 0, 0, 1, 0};
    facts.nearby->at(1).address = {2, 0, 0, 0, 2, 0};

    EXPECT_EQ(
        detail(24, facts, "networks"),
        R"([{"advertisedLoad":0.2,"band":"5GHz","bssid":"02:00:00:00:01:00","centreFrequencies":[5210],)"
        R"("channel":36,"frequency":5180,"joined":true,"modes":"","rssi":-52,"security":"Open",)"
        R"("ssid":"Northlight","width":80},)"
        R"({"band":"2.4GHz","bssid":"02:00:00:00:02:00","centreFrequencies":[2422],"channel":1,)"
        R"("frequency":2412,"joined":false,"modes":"","security":"Open","width":40}])");
    EXPECT_EQ(detail(24, facts, "channels"),
              R"([{"band":"2.4GHz","channel":1,"frequency":2412,"full":false,"judgedBy":"overlap",)"
              R"("listensOnly":false,"radar":false,"strongNeighbours":0,"value":0.0},)"
              R"({"band":"5GHz","channel":52,"frequency":5260,"full":false,"judgedBy":"overlap",)"
              R"("listensOnly":true,"radar":true,"strongNeighbours":0,"value":0.0}])");
    EXPECT_EQ(detail(24, facts, "judgedBy"), R"("advertisedLoad")");
    EXPECT_EQ(detail(24, facts, "value"), "0.2");
}

TEST(Details, OfABandNameTheFullChannelsAndTheLimitsThatWereApplied) {
    std::vector<AccessPoint> nearby;
    for (int i = 0; i < 2; ++i) nearby.push_back(heard(nameElement("Other"), 2437, -40));
    Facts facts = joinedTo({heard(nameElement("Northlight"), 2412, -60), nearby[0], nearby[1]});
    facts.allowedChannels = AllowedChannels{{2412}, {2437}, {2442}, {2462}};
    facts.settings.thresholds.congestion = {0.7, 200, 1.5};

    EXPECT_EQ(detail(25, facts, "consideredChannels"), "[1,6,11]");
    EXPECT_EQ(detail(25, facts, "fullChannels"), "[6]");
    EXPECT_EQ(detail(25, facts, "Thresholds"),
              R"({"advertisedLoad":0.784,"measuredLoad":0.7,"overlap":1.5})");
    EXPECT_EQ(detail(26, facts, "consideredChannels"), "[]");
}

TEST(Details, OfTheSignalAreItsSamplesAndItsDistanceToTheNoise) {
    Facts facts = joinedTo({heard(nameElement("Northlight"))});
    facts.station = Station{{-60, -58, -59}, {}, {}};
    facts.survey = Survey{{2412, true, -92}};

    EXPECT_EQ(detail(32, facts, "samples"), "[-60,-58,-59]");
    EXPECT_EQ(detail(32, facts, "noise"), "-92");
    EXPECT_EQ(detail(32, facts, "signalToNoise"), "33");
}

TEST(Details, OfTheCountryCountWhoSaysWhich) {
    const Frame us = element(7, {'U', 'S', ' '}), de = element(7, {'D', 'E', ' '});
    Facts facts = joinedTo({heard(us), heard(de), heard(de), heard(de, 2412, -90)});
    facts.regulation = Regulation{"US"};

    EXPECT_EQ(detail(28, facts, "countries"),
              R"([{"accessPoints":2,"code":"DE"},{"accessPoints":1,"code":"US"}])");
    EXPECT_EQ(detail(28, facts, "advertised"), R"("US")");
}

TEST(Details, OfMixedModesNameTheAccessPoints) {
    AccessPoint one = heard(nameElement("Home") + element(45, {}), 5180),
                other = heard(nameElement("Home"), 5180);
    one.address = {2, 0, 0, 0, 1, 0};
    other.address = {2, 0, 0, 0, 2, 0};

    EXPECT_EQ(detail(37, joinedTo({one, other}), "accessPoints"),
              R"([{"band":"5GHz","bssid":"02:00:00:00:01:00","joined":true,"modes":"n"},)"
              R"({"band":"5GHz","bssid":"02:00:00:00:02:00","joined":false,"modes":""}])");
}

TEST(Details, OfTheAddressesMethodSayWhoTold) {
    Facts facts;
    facts.setup = LinkSetup();
    facts.setup->methods = {std::string("auto"), failure(Reason::notJoined, "no connection")};
    facts.setup->toldBy = "NetworkManager";
    facts.setup->leaseText = std::string();
    EXPECT_EQ(detail(14, facts, "judgedBy"), R"("NetworkManager")");
    EXPECT_EQ(detail(14, facts, "lease"), "true");
    EXPECT_EQ(detail(15, facts, "judgedBy"), R"("NetworkManager")");
    EXPECT_EQ(detail(15, facts, "reason"), R"("notJoined")");
    EXPECT_EQ(detail(15, facts, "lease"), "");
    facts.setup->leaseText = failure(Reason::unavailable, "no lease");
    EXPECT_EQ(detail(14, facts, "lease"), "false");
}

TEST(Details, OfHiddenNetworksAreWhatTheirBeaconsTellAllTheSame) {
    Facts facts = joinedTo({heard(nameElement("Northlight")), heard(nameElement(""), 5180, -70)});
    AccessPoint late = heard(nameElement(std::string(6, '\0')), 2462, -80, kPrivacy);
    late.address = {2, 0, 0, 0, 9, 9};
    facts.listened = std::vector{late, late};
    EXPECT_EQ(detailsOf(30, facts).at("networks").as<ArrayPointer>()->get()->size(), 2U);
    EXPECT_NE(detail(30, facts, "networks").find(R"("bssid":"02:00:00:00:09:09")"), std::string::npos);
    EXPECT_NE(detail(30, facts, "networks").find(R"("channel":11)"), std::string::npos);
}

TEST(Details, OfAScanCountTheAccessPointsOfEachBand) {
    const Facts facts = joinedTo({heard(nameElement("Northlight")), heard(nameElement("Cafe"), 5180),
                                  heard(nameElement(""), 5200), heard(nameElement("Bay"), 60480)});
    EXPECT_EQ(
        detail(31, facts, "bands"),
        R"([{"accessPoints":1,"band":"other","hidden":0},{"accessPoints":1,"band":"2.4GHz","hidden":0},)"
        R"({"accessPoints":2,"band":"5GHz","hidden":1}])");
    EXPECT_EQ(detail(31, Facts(), "bands"), "");
}

TEST(Details, OfAHiddenNameSayHowTheBeaconHidesIt) {
    const auto shown = [](std::string_view name) {
        return detail(43, joinedTo({heard(nameElement(name))}), "inBeacon");
    };
    EXPECT_EQ(shown(""), R"("empty")");
    EXPECT_EQ(shown(std::string_view("\0\0", 2)), R"("zeros")");
    EXPECT_EQ(shown("Northlight"), R"("name")");

    AccessPoint answered = heard(nameElement(""));
    answered.says = decodeAdvertised(0, nameElement("Secret"), nameElement(""));
    EXPECT_EQ(detail(43, joinedTo({answered}), "nameKnown"), "true");
    answered.beaconElements.reset();
    answered.says = decodeAdvertised(0, nameElement("Secret"), std::nullopt);
    EXPECT_EQ(detail(43, joinedTo({answered}), "inBeacon"), "");
    EXPECT_EQ(detail(43, joinedTo({answered}), "reason"), R"("unsupported")");
}

TEST(Details, OfAHotspotAreTheKindsOfRulesThatMatch) {
    Facts facts = joinedTo({heard(nameElement("Phone") + vendorElement(0xAABBCC09))});
    facts.settings.vendors.hotspot = {{{{0xAA, 0xBB, 0xCC}, std::uint8_t{9}}}, {{2}}, {"METERED"}};
    facts.setup = LinkSetup();
    EXPECT_EQ(detail(44, facts, "matched"), R"(["vendorElement","addressPrefix"])");
    EXPECT_EQ(detail(44, facts, "leaseRead"), "false");
    facts.setup->leaseText = std::string("METERED");
    EXPECT_EQ(detail(44, facts, "matched"), R"(["vendorElement","addressPrefix","leaseText"])");
    EXPECT_EQ(detail(44, facts, "leaseRead"), "true");
}

TEST(Details, EveryTestHasSome) {
    for (const NumberedTest& each : numberedTests()) EXPECT_NE(each.details, nullptr) << each.number;
}

TEST(Details, OfAnAmbiguousNameSayWhy) {
    Facts facts = joinedTo(
        {heard(nameElement("linksys"), 2412, -50, kPrivacy), heard(nameElement("linksys"), 2412, -50)});
    facts.settings.vendors.commonNames = {*nameFromText("linksys")};

    EXPECT_EQ(detail(42, facts, "commonName"), "true");
    EXPECT_EQ(detail(42, facts, "securities"), R"(["Open","WEP"])");
}

TEST(Details, OfTheSecurityAreCiphersAndKeys) {
    const Facts facts = joinedTo(
        {heard(nameElement("Old") + wpaElement({2}, {2}) + rsnElement(2, {4}, {2}), 2412, -50, kPrivacy)});

    EXPECT_EQ(detail(40, facts, "ciphers"), R"(["TKIP","CCMP"])");
    EXPECT_EQ(detail(40, facts, "groupCiphers"), R"(["TKIP"])");
    EXPECT_EQ(detail(40, facts, "keyManagement"), R"(["PSK"])");
}

TEST(Details, OfTranslationAreTheAddressesOnTheWay) {
    Facts facts;
    TranslationEvidence evidence;
    evidence.own = {{address("10.0.0.7"), 24}};
    evidence.gatewayExternal = address("192.168.0.2");
    evidence.hops = {address("10.0.0.1"), std::nullopt};
    facts.translation = evidence;

    EXPECT_EQ(jsonText(Dictionary::make(detailsOf(8, facts)), JSONStyle::compact),
              R"({"hops":["10.0.0.1",null],"judgedBy":"routerInside","ownAddresses":["10.0.0.7"],)"
              R"("routerAddress":"192.168.0.2"})");

    evidence.gatewayExternal = address("100.64.5.6");
    facts.translation = evidence;
    EXPECT_EQ(detail(8, facts, "judgedBy"), R"("routerShared")");
}

TEST(Details, OfNameServersSayWhereTheyAreFrom) {
    Facts facts;
    facts.setup = LinkSetup{};
    facts.setup->nameServers =
        NameServers{{address("9.9.9.9")}, {address("10.0.0.1")}, {address("10.0.0.1")}, true};

    EXPECT_EQ(detail(16, facts, "servers"),
              R"([{"address":"9.9.9.9","asked":false,"manual":true,"offered":false},)"
              R"({"address":"10.0.0.1","asked":true,"manual":false,"offered":true}])");
}

TEST(Details, OfRememberedNetworksNameThoseThatConflict) {
    const auto network = [](std::string_view name, SavedSecurity security, bool hidden) {
        SavedNetwork saved;
        saved.name = *nameFromText(name);
        saved.security = security;
        saved.hidden = hidden;
        return saved;
    };
    Facts facts;
    facts.saved = SavedNetworks{
        "store",
        {network("A", SavedSecurity::open, false), network("A", SavedSecurity::sae, true),
         network("B", SavedSecurity::sae, false), network("B", SavedSecurity::wpa2Personal, false)}};

    EXPECT_EQ(detail(29, facts, "networks"), R"([{"security":[0,5],"ssid":"A"}])");
    EXPECT_EQ(detail(48, facts, "networks"), R"([{"ssid":"A"}])");
    EXPECT_EQ(detail(47, facts, "Thresholds"), R"({"networks":50})");
}

/// An HE operation of 6 GHz: the flags say whether other parts stand before the 6 GHz part.
Frame he6(std::uint8_t width, std::uint8_t first, std::uint8_t second, bool otherParts) {
    Frame body{36, 0, static_cast<std::uint8_t>(otherParts ? 0xC0 : 0), 2, 0, 0, 0};
    if (otherParts) body = body + Frame{1, 42, 0, 9};
    return element(255, body + Frame{37, width, first, second, 6});
}

ChannelUse use(std::uint32_t frequency, const Frame& frame) {
    return channelUseOf(heard(frame, frequency));
}

TEST(ChannelUse, OfSixGigahertzIsInTheHeOperation) {
    EXPECT_EQ(use(6135, he6(0, 37, 0, false)).width, 20U);
    EXPECT_EQ(use(6135, he6(1, 35, 0, true)).centres, std::vector<std::uint32_t>{6125});
    EXPECT_EQ(use(6135, he6(2, 39, 0, true)).width, 80U);
    EXPECT_EQ(use(6135, he6(3, 39, 47, false)).width, 160U);
    EXPECT_EQ(use(6135, he6(3, 39, 47, false)).centres, std::vector<std::uint32_t>{6185});
    EXPECT_EQ(use(6135, he6(3, 39, 119, false)).centres, (std::vector<std::uint32_t>{6145, 6545}));
    EXPECT_EQ(use(6135, element(255, {36, 0, 0, 2, 0, 0, 0, 37, 2})).width, 20U);
}

TEST(ChannelUse, OfTheBeaconComesBeforeThatOfAnOldAnswer) {
    AccessPoint moved = heard(element(192, {1, 42, 0, 0, 0}), 5180);
    moved.elements = element(192, {0, 0, 0, 0, 0});
    EXPECT_EQ(channelUseOf(moved).width, 80U);
    moved.beaconElements = nameElement("Northlight");
    moved.elements = element(192, {1, 42, 0, 0, 0});
    EXPECT_EQ(channelUseOf(moved).width, 80U);
}

TEST(ChannelUse, OfTheLatestModeComesFirst) {
    const Frame eht = element(255, {106, 1, 0, 0, 0, 0, 4, 47, 31});
    EXPECT_EQ(use(6135, he6(3, 39, 47, false) + eht).width, 320U);
    EXPECT_EQ(use(6135, he6(3, 39, 47, false) + eht).centres, std::vector<std::uint32_t>{6105});
    EXPECT_EQ(use(5180, element(192, {1, 42, 0, 0, 0}) + element(255, {106, 0, 0, 0, 0, 0})).width, 80U);
}

}  // namespace
}  // namespace wp
