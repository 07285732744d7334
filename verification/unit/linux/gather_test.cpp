#include "linux/gather.h"

#include <gtest/gtest.h>
#include <linux/nl80211.h>
#include <net/if.h>
#include <poll.h>
#include <stdlib.h>

#include <algorithm>
#include <filesystem>
#include <future>

#include "linux/fact_table.h"
#include "linux/gather_reach.h"
#include "linux/gather_setup.h"
#include "linux/probe/ip_socket.h"
#include "linux/route_query.h"
#include "verification/unit/fakes/temporary_folder.h"
#include "verification/unit/linux/fakes/loopback_socket.h"
#include "verification/unit/linux/fakes/refusing_kernel.h"
#include "verification/unit/linux/fakes/udp_server.h"
#include "verification/unit/linux/fakes/web_server.h"
#include "verification/unit/linux/stop.h"

namespace wp {
namespace {

/// A link over the loopback interface that has joined a network.
Link loopback() {
    AccessPoint joined;
    joined.joined = true;
    return {"lo", if_nametoindex("lo"), 0, true, joined};
}

Link notJoined() {
    Link link = loopback();
    link.joined.reset();
    return link;
}

template <class T>
std::string textOf(const Known<T>& known) {
    return known ? "known" : known.error().text();
}

/// A listening socket whose peer never answers; it raises the signal once somebody has connected, so that no time
/// decides when.
class SilentPlace {
  public:
    SilentPlace() {
        thread_ = std::thread([this] {
            pollfd entries[] = {{listening_.number(), POLLIN, 0}, {over_.descriptor(), POLLIN, 0}};
            ::poll(entries, 2, -1);
            stop->raise();
        });
    }
    ~SilentPlace() {
        over_.raise();
        thread_.join();
    }
    std::string hostAndPort() const { return "127.0.0.1:" + std::to_string(listening_.port()); }

    const std::shared_ptr<StopSignal> stop = std::make_shared<StopSignal>();

  private:
    const LoopbackSocket listening_ = LoopbackSocket::listening();
    StopSignal over_;
    std::thread thread_;
};

TEST(GatherRadio, WithoutTheInterfaceSaysWhatIsMissing) {
    const auto link = gatherLink("no-such-wifi", patience());
    ASSERT_FALSE(link);
    const bool namesIt = link.error().message == "the kernel knows no Wi-Fi (nl80211)" ||
                         link.error().message == "no Wi-Fi interface named no-such-wifi";
    EXPECT_TRUE(namesIt) << link.error().text();
    EXPECT_EQ(link.error().code, static_cast<int>(Reason::noInterface));
}

TEST(GatherRadio, OfALinkThatHasJoinedNothingNothingIsAsked) {
    EchoSocket socket;
    HomeChannel home;
    HomeChannel::Stay stay(home);
    EXPECT_EQ(textOf(gatherStation(notJoined(), patience())), "lo is not joined to a network (code 2)");
    EXPECT_EQ(textOf(gatherGatewayEcho(notJoined(), socket, stay, patience())),
              "lo is not joined to a network (code 2)");
    Link down = notJoined();
    down.up = false;
    EXPECT_EQ(textOf(gatherStation(down, patience())), "lo is down (code 1)");
}

TEST(GatherRadio, BeingStoppedCountsBeforeEverythingElse) {
    const auto stop = std::make_shared<StopSignal>();
    stop->raise();
    const Until over = patience(std::chrono::seconds(20), stop);
    HomeChannel home;
    HomeChannel::Stay stay(home);
    for (const std::string& text :
         {textOf(gatherLink(std::nullopt, over)), textOf(gatherStationInterfaces(over)),
          textOf(gatherAirtime(loopback(), stay, over)), textOf(gatherSurvey(loopback(), over)),
          textOf(gatherRegulation(loopback(), over)), textOf(gatherAllowedChannels(loopback(), over)),
          textOf(gatherAddresses(loopback(), over)), textOf(gatherPeerLinks(loopback(), "", over))})
        EXPECT_EQ(text, "cancelled (code 8)");
}

TEST(GatherAddresses, OfLoopbackReachNobody) {
    const auto addresses = gatherAddresses(loopback(), patience());
    ASSERT_TRUE(addresses) << addresses.error().text();
    ASSERT_FALSE(addresses->empty());
    EXPECT_TRUE(std::ranges::none_of(*addresses, &Address::global));
}

TEST(GatherEcho, NeedsARouter) {
    EchoSocket socket;
    HomeChannel home;
    HomeChannel::Stay stay(home);
    EXPECT_EQ(textOf(gatherGatewayEcho(loopback(), socket, stay, patience())),
              "lo has no default route (code 2)");
    EXPECT_EQ(textOf(gatherOutsideEcho(loopback(), {}, socket, stay, patience())),
              "lo has no default route (code 2)");
    EXPECT_EQ(textOf(gatherOutsideEcho(notJoined(), {}, socket, stay, patience())),
              "lo is not joined to a network (code 2)");
}

/// Who of five echo requests to an address was answered.
Known<Echo> echoFrom(const char* address, HomeChannel::Stay& stay) {
    EchoSocket socket;
    return socket.ask(*IPAddress::fromText(address), "lo", loopback().interfaceIndex, stay, patience());
}

constexpr const char* kAnswering = "127.0.0.1";
// Of documentation (RFC 5737): what leaves for it by the loopback interface reaches nobody.
constexpr const char* kSilent = "192.0.2.1";

bool isAnswered(const std::optional<double>& roundTrip) {
    return roundTrip.has_value();
}

TEST(EchoSocket, GivesTheChannelUpWhereNothingIsAnswered) {
    HomeChannel home;
    HomeChannel::Stay stay(home);
    const Known<Echo> echo = echoFrom(kSilent, stay);
    ASSERT_TRUE(echo) << echo.error().text();
    EXPECT_TRUE(std::ranges::none_of(echo->roundTrips, isAnswered));
    EXPECT_EQ(Wait::ready, home.leave(HomeChannel::Visit::lengthy, patience(std::chrono::milliseconds(0))));
}

TEST(EchoSocket, KeepsTheChannelToItsEndWhereItIsAnswered) {
    HomeChannel home;
    HomeChannel::Stay stay(home);
    const Known<Echo> echo = echoFrom(kAnswering, stay);
    ASSERT_TRUE(echo) << echo.error().text();
    EXPECT_TRUE(std::ranges::all_of(echo->roundTrips, isAnswered));
    EXPECT_EQ(Wait::timeout, home.leave(HomeChannel::Visit::lengthy, patience(std::chrono::milliseconds(0))));
}

TEST(EchoSocket, WaitsForARadioThatStaysAwayOnlySoLong) {
    HomeChannel home;
    home.leftByOthers();
    HomeChannel::Stay stay(home);
    const Known<Echo> echo = echoFrom(kAnswering, stay);
    ASSERT_TRUE(echo) << echo.error().text();
    EXPECT_TRUE(std::ranges::all_of(echo->roundTrips, isAnswered));
}

/// A busy machine may miss all pauses of a row, but not of every row.
TEST(EchoSocket, LetsVisitsHappenBetweenAnAnswerAndTheNextRequest) {
    HomeChannel home;
    bool wasVisited = false;
    for (int row = 0; row < 20 && !wasVisited; ++row) {
        HomeChannel::Stay stay(home);
        const auto over = std::make_shared<StopSignal>();
        auto visitor = std::async(std::launch::async, [&] {
            const Wait wait = home.leave(HomeChannel::Visit::brief, patience(std::chrono::seconds(20), over));
            if (wait == Wait::ready) home.returned();
            return wait == Wait::ready;
        });
        const Known<Echo> echo = echoFrom(kAnswering, stay);
        over->raise();
        wasVisited = visitor.get();
        ASSERT_TRUE(echo) << echo.error().text();
        EXPECT_TRUE(std::ranges::all_of(echo->roundTrips, isAnswered));
    }
    EXPECT_TRUE(wasVisited);
}

TEST(RouteQuery, LeadsOverLoopbackToNobodyElse) {
    const auto outside = routeOver(loopback(), *IPAddress::fromText("192.0.2.1"), patience());
    const auto itself = routeFor({*IPAddress::fromText("127.0.0.1")}, patience());
    const auto ways = gatherWaysOut(loopback(), patience());

    ASSERT_TRUE(outside && itself && ways);
    EXPECT_FALSE(outside->has_value());
    EXPECT_FALSE(itself->has_value());
    EXPECT_TRUE(ways->empty());
}

TEST(RouteQuery, EndsWhenItIsStopped) {
    const auto stop = std::make_shared<StopSignal>();
    stop->raise();
    EXPECT_EQ(textOf(gatherWaysOut(loopback(), patience(std::chrono::seconds(20), stop))),
              "cancelled (code 8)");
}

TEST(IpSocket, OfDatagramsHasTheAddressThatTheKernelSendsFrom) {
    const IPAddress here = *IPAddress::fromText("127.0.0.7");
    const auto socket = ipSocket(SOCK_DGRAM, here, "lo");
    ASSERT_TRUE(socket);
    SocketAddress own;
    own.size = sizeof own.storage;
    ASSERT_EQ(0, getsockname(socket->number(), reinterpret_cast<sockaddr*>(&own.storage), &own.size));

    EXPECT_EQ(sourceToward(here, "lo"), own.address());
    EXPECT_TRUE(own.address()->loopback());
    EXPECT_EQ(std::nullopt, sourceToward(here, "no-such-wifi"));
}

TEST(GatherReach, WithoutARouterNothingIsSearched) {
    EXPECT_EQ(textOf(gatherRouter(loopback(), patience())), "lo has no default route for IPv4 (code 2)");
    EXPECT_EQ(textOf(gatherTranslation(loopback(), {}, std::nullopt, {}, patience())),
              "lo has no default route for IPv4 (code 2)");
}

TEST(GatherReach, EndpointsThatAreEmptyCannotBeTold) {
    Endpoints none;
    none.name = none.portalPlain = none.portalSecure = none.vendorHost = none.vendorUrl = "";
    EXPECT_EQ(textOf(gatherNameAnswer(loopback(), {}, none, patience())),
              "no endpoint is configured for names (code 9)");
    EXPECT_EQ(textOf(gatherPortal(loopback(), {}, none, patience())),
              "no endpoint is configured for the captive portal's probe (code 9)");
    const auto contacts = gatherVendorService(loopback(), {}, none, patience());
    ASSERT_TRUE(contacts);
    EXPECT_EQ(textOf(contacts->reach), "no endpoint is configured for the vendor's service (code 9)");
    EXPECT_EQ(textOf(contacts->retrieve), "no endpoint is configured for the vendor's service (code 9)");
}

TEST(GatherReach, AnEndpointThatIsEmptyIsNotLookedUp) {
    Endpoints none;
    none.portalPlain = none.portalSecure = "";
    LinkSetup setup;
    setup.servers = {*IPAddress::fromText("192.0.2.1")};
    setup.portalApi = "urn:ietf:params:capport:unrestricted";
    // To ask for a name would end as an error there.
    const auto evidence =
        fakes::whereBindingsAreRefused([&] { return gatherPortal(loopback(), setup, none, patience()); });
    EXPECT_EQ(textOf(evidence), "known");
}

TEST(GatherReach, ALinkWhoseServersAreAllAnotherInterfacesCannotTell) {
    LinkSetup setup;
    setup.serversElsewhere = {*IPAddress::fromText("10.8.0.1")};
    const std::string reason = "no name server of lo is known: to 10.8.0.1 another interface leads (code 4)";
    EXPECT_EQ(textOf(gatherNameAnswer(loopback(), setup, {}, patience())), reason);
    EXPECT_EQ(textOf(gatherPortal(loopback(), setup, {}, patience())), reason);
    const auto contacts = gatherVendorService(loopback(), setup, {}, patience());
    ASSERT_TRUE(contacts);
    EXPECT_EQ(textOf(contacts->reach), reason);
}

TEST(GatherReach, ALinkWithoutNameServersHasNoAnswer) {
    const auto answer = gatherNameAnswer(loopback(), {}, {}, patience());
    ASSERT_TRUE(answer);
    EXPECT_EQ(answer->why, "there is no name server");
}

class GatherWeb : public ::testing::Test {
  protected:
    static void SetUpTestSuite() { server_ = new WebServer; }
    static void TearDownTestSuite() { delete server_; }

    static Endpoints endpoints() {
        Endpoints endpoints;
        endpoints.portalPlain = server_->plain("/204");
        endpoints.portalSecure = server_->secure("/204");
        endpoints.vendorHost = server_->secure("").substr(std::string("https://").size());
        endpoints.vendorUrl = server_->secure("/page");
        endpoints.certificateAuthorities = server_->certificate();
        return endpoints;
    }
    static PortalEvidence portal(const Endpoints& endpoints, const LinkSetup& setup = {}) {
        const auto evidence = gatherPortal(loopback(), setup, endpoints, patience());
        EXPECT_TRUE(evidence) << textOf(evidence);
        return evidence ? *evidence : PortalEvidence();
    }

    inline static WebServer* server_ = nullptr;
};

TEST_F(GatherWeb, ThePortalsProbesBringStatusAndWhoAnswered) {
    const PortalEvidence open = portal(endpoints());
    EXPECT_EQ(open.plain.status, 204);
    EXPECT_EQ(open.plain.server, IPAddress::fromText("127.0.0.1"));
    EXPECT_EQ(open.declared.captive, std::nullopt);
    Endpoints led = endpoints();
    led.portalPlain = server_->plain("/redirect");
    EXPECT_EQ(portal(led).plain.location, server_->plain("/login"));
}

TEST_F(GatherWeb, AnEmptyPageWaitsForTheSecureAnswer) {
    Endpoints empty = endpoints();
    empty.portalPlain = server_->plain("/empty");
    const PortalEvidence evidence = portal(empty);
    EXPECT_EQ(evidence.plain.status, 200);
    EXPECT_EQ(evidence.plain.bodySize, 0U);
    EXPECT_EQ(evidence.secure.status, 204);
}

TEST_F(GatherWeb, ThatHTTPGetsThroughSaysNothingOfHTTPS) {
    EXPECT_EQ(connectivityOf(portal(endpoints())), Connectivity::full);
    Endpoints closed = endpoints();
    closed.portalSecure = "https://127.0.0.9:1/";  // nobody listens there
    EXPECT_EQ(connectivityOf(portal(closed)), Connectivity::partial);
    Endpoints stranger = endpoints();
    stranger.certificateAuthorities.clear();
    EXPECT_EQ(connectivityOf(portal(stranger)), std::nullopt) << "its certificate is nobody's";
    stranger.certificateAuthorities = "/no/such/folder";
    EXPECT_EQ(connectivityOf(portal(stranger)), std::nullopt);
    Endpoints plainAlone = endpoints();
    plainAlone.portalSecure.clear();
    EXPECT_EQ(connectivityOf(portal(plainAlone)), std::nullopt);
}

TEST_F(GatherWeb, NeedsNoFurtherThread) {
    const auto contacts = fakes::whereThreadsAreRefused(
        [] { return gatherVendorService(loopback(), {}, endpoints(), patience()); });
    ASSERT_TRUE(contacts && contacts->reach && contacts->retrieve);
    EXPECT_EQ(contacts->reach->end, ServiceContact::End::reached);
    EXPECT_EQ(contacts->retrieve->status, 200);
}

TEST_F(GatherWeb, TheNetworksOwnWordIsAskedForOverASecureConnectionAlone) {
    LinkSetup setup;
    setup.portalApi = server_->secure("/api");
    EXPECT_EQ(portal(endpoints(), setup).declared.captive, true);
    setup.portalApi = server_->plain("/api");
    EXPECT_EQ(portal(endpoints(), setup).declared.captive, std::nullopt);
    setup.portalApi = "urn:ietf:params:capport:unrestricted";
    EXPECT_TRUE(portal(endpoints(), setup).declared.unrestricted);
    EXPECT_TRUE(portal({}, setup).declared.unrestricted) << "though no probe is configured";
}

TEST_F(GatherWeb, TheVendorsServiceIsReachedAndItsContentRead) {
    const auto contacts = gatherVendorService(loopback(), {}, endpoints(), patience());
    ASSERT_TRUE(contacts && contacts->reach && contacts->retrieve);
    EXPECT_EQ(contacts->reach->end, ServiceContact::End::reached);
    EXPECT_EQ(contacts->retrieve->status, 200);
    EXPECT_EQ(contacts->retrieve->body, "<html>please log in</html>");
    EXPECT_FALSE(contacts->clock.beforeBuild);
}

TEST_F(GatherWeb, ACertificateThatNobodyKnowsIsTold) {
    Endpoints stranger = endpoints();
    stranger.certificateAuthorities.clear();
    const auto contacts = gatherVendorService(loopback(), {}, stranger, patience());
    ASSERT_TRUE(contacts && contacts->reach && contacts->retrieve);
    EXPECT_EQ(contacts->reach->end, ServiceContact::End::badCertificate);
    EXPECT_EQ(contacts->retrieve->end, ServiceContact::End::badCertificate);
}

TEST_F(GatherWeb, ADeviceWithoutAuthoritiesSaysSoInPlaceOfAVerdict) {
    Endpoints alone = endpoints();
    alone.certificateAuthorities = "/no/such/folder";
    const auto contacts = gatherVendorService(loopback(), {}, alone, patience());
    ASSERT_TRUE(contacts);
    const std::string reason = "no certificates of authorities in /no/such/folder (code 9)";
    EXPECT_EQ(textOf(contacts->reach), reason);
    EXPECT_EQ(textOf(contacts->retrieve), reason);
    EXPECT_EQ(portal(alone).plain.status, 204);
}

TEST_F(GatherWeb, APageThatBreaksOffBeforeItBeganIsNoAnswerHoweverLongItWasSaidToBe) {
    for (const char* path : {"/until-reset/", "/page-that-never-comes"}) {
        Endpoints broken = endpoints();
        broken.portalPlain = server_->plain(path);
        const PortalEvidence evidence = portal(broken);
        EXPECT_EQ(evidence.plain.status, 200) << path;
        EXPECT_EQ(evidence.plain.bodySize, 0U) << path;
        EXPECT_FALSE(evidence.plain.bodyIsWhole) << path;
        EXPECT_EQ(evidence.secure.status, 204) << path;
        const auto judged = judgePortal(evidence);
        ASSERT_TRUE(judged) << path;
        EXPECT_EQ(judged->why, "partial: HTTPS got through, HTTP did not") << path;
    }
}

TEST_F(GatherWeb, ContentThatBreaksOffHasArrivedWhereItsWholeBeginningCame) {
    const struct {
        const char* path;
        bool arrives, isWhole;
    } cases[] = {{"/until-cut/<html>please", true, false},
                 {"/until-reset/<html>", true, false},
                 {"/until-cut/<htm", false, false},
                 {"/until-reset/<htm", false, false},
                 {"/until-cut/", false, false},
                 {"/until-cut/please<html>", false, false},
                 {"/page-that-never-comes", false, false},
                 {"/until-closed", true, true}};
    for (const auto& each : cases) {
        Endpoints cut = endpoints();
        cut.vendorUrl = server_->secure(each.path);
        const auto contacts = gatherVendorService(loopback(), {}, cut, patience());
        ASSERT_TRUE(contacts && contacts->retrieve) << each.path;
        const Outcome outcome = retrievesFromVendor(contacts->retrieve, {"<html>"}, contacts->clock);
        ASSERT_TRUE(outcome) << each.path;
        EXPECT_EQ(outcome->result, each.arrives) << each.path;
        EXPECT_EQ(contacts->retrieve->why.empty(), each.isWhole) << each.path;
    }
}

TEST_F(GatherWeb, APageWithoutAnEndIsTakenAtItsBeginning) {
    Endpoints endless = endpoints();
    endless.portalPlain = server_->plain("/endless-page");
    const PortalEvidence evidence = portal(endless);
    EXPECT_EQ(evidence.plain.status, 200);
    EXPECT_GT(evidence.plain.bodySize, 1U);
}

TEST(GatherReach, WhoeverWaitsForASilentServerReturnsAtOnceWhenStopped) {
    const SilentPlace portal, vendor;
    Endpoints endpoints;
    endpoints.portalPlain = "http://" + portal.hostAndPort() + "/";
    endpoints.portalSecure = "https://" + portal.hostAndPort() + "/";
    endpoints.vendorHost = vendor.hostAndPort();
    endpoints.vendorUrl = "https://" + vendor.hostAndPort() + "/";
    EXPECT_EQ(textOf(gatherPortal(loopback(), {}, endpoints, patience(std::chrono::minutes(5), portal.stop))),
              "cancelled (code 8)");
    const auto contacts =
        gatherVendorService(loopback(), {}, endpoints, patience(std::chrono::minutes(5), vendor.stop));
    ASSERT_TRUE(contacts);
    EXPECT_EQ(textOf(contacts->reach), "cancelled (code 8)");
    EXPECT_EQ(textOf(contacts->retrieve), "cancelled (code 8)");
}

TEST(FactRows, AReasonNamesWhatIsMissingAndWhatItCosts) {
    setenv("DBUS_SYSTEM_BUS_ADDRESS", "unix:path=/no/such/bus", 1);
    Sources sources;
    Facts facts;
    facts.link = loopback();
    const FactRow& row = rowOf(Fact::saved);
    row.gather({facts, {}, 0, sources, patience(), row.loss})(facts);
    unsetenv("DBUS_SYSTEM_BUS_ADDRESS");

    EXPECT_EQ(textOf(facts.saved),
              "there is no message bus; without it nobody can tell the remembered networks (code 4)");
}

TEST(FactRows, WithoutALinkTheReasonIsTheLinks) {
    Sources sources;
    Facts facts;
    facts.link = failure(Reason::noInterface, "no Wi-Fi interface");
    for (const Fact fact : {Fact::nearby, Fact::saved, Fact::setup, Fact::gatewayEcho, Fact::survey}) {
        const FactRow& row = rowOf(fact);
        row.gather({facts, {}, 0, sources, patience(), row.loss})(facts);
    }
    EXPECT_EQ(textOf(facts.nearby), "no Wi-Fi interface (code 1)");
    EXPECT_EQ(textOf(facts.saved), "no Wi-Fi interface (code 1)");
    EXPECT_EQ(textOf(facts.survey), "no Wi-Fi interface (code 1)");
    EXPECT_EQ(textOf(facts.gatewayEcho), "no Wi-Fi interface (code 1)");
}

/// A folder that stands for the root of a system with one driver of a Wi-Fi interface.
class Driver : public ::testing::Test {
  protected:
    void use(const std::string& driver) const {
        const std::filesystem::path device = root_ + "/sys/class/net/lo/device";
        std::filesystem::create_directories(device);
        std::filesystem::remove(device / "driver");
        std::filesystem::create_symlink("../../../bus/pci/drivers/" + driver, device / "driver");
    }
    void setParameter(const std::string& path, const std::string& content) const {
        write("/sys/module/" + path, content);
    }
    void write(const std::string& path, const std::string& content) const { folder_.write(path, content); }
    Known<bool> sharing() const { return gatherAirtimeSharing(loopback(), root_); }

    fakes::TemporaryFolder folder_;
    const std::string& root_ = folder_.path();
};

TEST_F(Driver, TellsWhetherItSharesAirtimeByItsSwitch) {
    use("iwlwifi");
    setParameter("iwlwifi/parameters/bt_coex_active", "Y\n");
    EXPECT_EQ(*sharing(), true);
    setParameter("iwlwifi/parameters/bt_coex_active", "N\n");
    EXPECT_EQ(*sharing(), false);
    use("ath9k");
    setParameter("ath9k/parameters/btcoex_enable", "1\n");
    EXPECT_EQ(*sharing(), true);
}

TEST_F(Driver, TellsItInTheFolderForDebugging) {
    const std::string folder = "/sys/kernel/debug/ieee80211/phy7/";
    write("/sys/class/net/lo/phy80211/name", "phy7\n");
    use("ath10k_pci");
    EXPECT_FALSE(sharing());
    write(folder + "ath10k/btcoex", "1\n");
    EXPECT_EQ(*sharing(), true);
    write(folder + "ath10k/btcoex", "0\n");
    EXPECT_EQ(*sharing(), false);
}

TEST_F(Driver, ThatReportsOnCoexistenceIsTakenAtItsWord) {
    write("/sys/class/net/lo/phy80211/name", "phy7\n");
    use("rtw_8822ce");
    const auto told = [&](const std::string& report) {
        write("/sys/kernel/debug/ieee80211/phy7/rtw88/coex_info", report);
        return sharing() ? *sharing() ? "shares" : "does not" : "cannot tell";
    };
    const std::string shared = "Mech/ RFE                                = Shared/ 4\n";
    EXPECT_STREQ(told(shared), "shares");
    EXPECT_STREQ(told("Mech/ RFE                                = Non-Shared/ 4\n"), "cannot tell");
    EXPECT_STREQ(told("============[Under Manual Control]============\n" + shared), "does not");
    EXPECT_STREQ(told(shared + "Coex Ver/ BT Dez/ BT Rpt = 20070114/ 0x11/ 0x00000000 (BT disabled)\n"),
                 "does not");
    use("rtw89_8852ae");
    EXPECT_FALSE(sharing());
}

TEST_F(Driver, WithoutASwitchIsNoGuess) {
    EXPECT_EQ(textOf(sharing()),
              "the driver (unknown) does not tell whether it shares airtime with Bluetooth (code 5)");
    use("iwlwifi");
    EXPECT_EQ(textOf(sharing()),
              "the driver iwlwifi does not tell whether it shares airtime with Bluetooth (code 5)");
    use("mt7921e");
    setParameter("iwlwifi/parameters/bt_coex_active", "Y\n");
    EXPECT_EQ(textOf(sharing()),
              "the driver mt7921e does not tell whether it shares airtime with Bluetooth (code 5)");
}

TEST(Switch, OfTheInterfacesRadioTellsWhyItIsDown) {
    const fakes::TemporaryFolder root;
    const std::string folder = "/sys/class/net/wlan0/phy80211/rfkill3/";
    EXPECT_FALSE(isSwitchedOff("wlan0", root.path()));
    root.write(folder + "soft", "0\n");
    root.write(folder + "hard", "0\n");
    EXPECT_FALSE(isSwitchedOff("wlan0", root.path()));
    root.write(folder + "soft", "1\n");
    EXPECT_TRUE(isSwitchedOff("wlan0", root.path()));
    EXPECT_FALSE(isSwitchedOff("wlan1", root.path()));
    root.write(folder + "soft", "0\n");
    root.write(folder + "hard", "1\n");
    EXPECT_TRUE(isSwitchedOff("wlan0", root.path()));

    Link link = notJoined();
    link.up = false;
    EXPECT_EQ("lo is down (code 1)", isDown(link).text());
    link.switchedOff = true;
    EXPECT_EQ("lo is down: Wi-Fi is switched off (code 1)", isDown(link).text());
}

TEST(Interfaces, ThatJoinNoNetworksAreNamedWhereNoneDoes) {
    const std::vector<RadioInterface> all = {{"wlan0", 3, 0, NL80211_IFTYPE_MONITOR, {}},
                                             {"wlan1", 4, 0, NL80211_IFTYPE_STATION, {}},
                                             {"wlan2", 5, 0, NL80211_IFTYPE_AP, {}}};

    EXPECT_EQ("no Wi-Fi interface named eth0 (code 1)", noStation(all, "eth0").text());
    EXPECT_EQ("no Wi-Fi interface named wlan0 that joins networks: wlan0 is a monitor (code 1)",
              noStation(all, "wlan0").text());
    EXPECT_EQ("no Wi-Fi interface that joins networks: wlan0 is a monitor, wlan2 is an access point (code 1)",
              noStation(all, std::nullopt).text());
    EXPECT_EQ("no Wi-Fi interface (code 1)", noStation({}, std::nullopt).text());
}

/// The names in the order of use, of interfaces named after what they are.
std::string inOrderOfUse(const std::vector<std::string>& names) {
    std::vector<RadioInterface> interfaces;
    for (const std::string& name : names)
        interfaces.push_back({name, static_cast<std::uint32_t>(interfaces.size()), 0, 0, {}});
    putInUseFirst(interfaces, [](const RadioInterface& each) {
        return each.name.starts_with("joined") ? Use::joined
               : each.name.starts_with("up")   ? Use::up
                                               : Use::down;
    });
    std::string order;
    for (const RadioInterface& each : interfaces) order += each.name + ' ';
    return order;
}

TEST(Interfaces, ThoseInUseComeFirst) {
    EXPECT_EQ(inOrderOfUse({"down0", "up1", "joined2"}), "joined2 up1 down0 ");
    EXPECT_EQ(inOrderOfUse({"down0", "up1"}), "up1 down0 ");
    EXPECT_EQ(inOrderOfUse({"down0", "down1", "up2", "up3"}), "up2 up3 down0 down1 ");
    EXPECT_EQ(inOrderOfUse({}), "");
}

}  // namespace
}  // namespace wp
