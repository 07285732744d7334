#include <gtest/gtest.h>

#include "service/captive_portal.h"
#include "service/double_translation.h"
#include "service/reachability.h"
#include "verification/unit/service/addresses.h"
#include "verification/unit/service/finding.h"
#include "verification/unit/service/portal_answers.h"

namespace wp {
namespace {

TranslationEvidence behind(std::string_view own) {
    TranslationEvidence evidence;
    evidence.own = {{address(own), 24}};
    return evidence;
}

TEST(DoubleTranslation, AGlobalAddressIsNotTranslatedAtAll) {
    EXPECT_FALSE(found(hasDoubleTranslation(behind("203.0.113.7"))));
    EXPECT_FALSE(found(hasDoubleTranslation(TranslationEvidence{})));
}

TEST(DoubleTranslation, ARouterWithAnInnerAddressOutsideIsCertain) {
    for (const char* outer : {"192.168.0.2", "10.1.1.1", "172.20.0.1", "100.64.3.3"}) {
        TranslationEvidence evidence = behind("192.168.1.20");
        evidence.gatewayExternal = address(outer);
        evidence.mapped = address("203.0.113.7");
        EXPECT_TRUE(found(hasDoubleTranslation(evidence))) << outer;
    }
}

TEST(DoubleTranslation, TheRouterAndAServerOutsideDecideAgainstTheHops) {
    TranslationEvidence evidence = behind("192.168.1.20");
    evidence.gatewayExternal = address("203.0.113.7");
    evidence.mapped = address("203.0.113.7");
    evidence.hops = {address("192.168.1.1"), address("10.0.0.1")};
    EXPECT_FALSE(found(hasDoubleTranslation(evidence)));
    evidence.mapped = address("198.51.100.9");
    EXPECT_TRUE(found(hasDoubleTranslation(evidence)));
    evidence.mapped.reset();
    EXPECT_FALSE(found(hasDoubleTranslation(evidence)));
}

TEST(DoubleTranslation, AnotherInnerNetworkOnTheWayIsLikely) {
    TranslationEvidence evidence = behind("192.168.1.20");
    evidence.mapped = address("203.0.113.7");
    evidence.hops = {address("192.168.1.1"), address("192.168.0.1"), address("203.0.113.1")};
    EXPECT_TRUE(found(hasDoubleTranslation(evidence)));
    evidence.hops = {address("192.168.1.1"), address("203.0.113.1"), address("10.0.0.1")};
    EXPECT_FALSE(found(hasDoubleTranslation(evidence)));
    evidence.hops = {address("192.168.1.1"), std::nullopt, address("192.168.1.2"), address("203.0.113.1")};
    EXPECT_FALSE(found(hasDoubleTranslation(evidence)));
}

TEST(DoubleTranslation, SharedAddressesOnTheWayAreTheProvidersTranslator) {
    TranslationEvidence evidence = behind("192.168.1.20");
    evidence.hops = {address("192.168.1.1"), address("100.64.0.1"), address("203.0.113.1")};
    const auto judged = judgeTranslation(evidence);
    ASSERT_TRUE(judged);
    EXPECT_TRUE(judged->twice);
    EXPECT_EQ(judged->why, "carrier-grade: 100.64.0.1");
}

TEST(DoubleTranslation, SilenceIsAnErrorNotAVerdict) {
    TranslationEvidence evidence = behind("192.168.1.20");
    evidence.hops = {address("192.168.1.1"), std::nullopt, std::nullopt, std::nullopt};
    EXPECT_TRUE(cannotTell(hasDoubleTranslation(evidence), Reason::timeout));
}

TEST(NameResolution, OnlyAnAddressThatLeadsOutsideCounts) {
    const auto resolved = [](std::vector<IPAddress> addresses) {
        return found(resolvesNames(NameAnswer{"example.com", std::move(addresses), {}, {}}));
    };
    EXPECT_TRUE(resolved({address("203.0.113.7")}));
    EXPECT_TRUE(resolved({address("10.0.0.1"), address("2001:db8::1")}));
    EXPECT_FALSE(resolved({address("10.0.0.1")}));
    EXPECT_FALSE(resolved({address("0.0.0.0"), address("127.0.0.1"), address("fe80::1")}));
    EXPECT_FALSE(resolved({}));
    EXPECT_TRUE(cannotTell(resolvesNames(failure(Reason::cancelled, "cancelled")), Reason::cancelled));
}

TEST(NameResolution, ANameThatLeadsToThisDeviceLeadsNowhere) {
    const NameAnswer blocked{
        "host.example", {address("0.0.0.0"), address("127.0.0.1"), address("::")}, {}, {}};
    EXPECT_TRUE(placesOf(blocked).empty());
    EXPECT_EQ(whyNowhere(blocked), "the name servers lead host.example nowhere, to 0.0.0.0");

    const NameAnswer local{"host.example", {address("0.0.0.0"), address("10.0.0.1")}, {}, {}};
    EXPECT_EQ(placesOf(local), std::vector{address("10.0.0.1")});

    EXPECT_EQ(whyNowhere(NameAnswer{"host.example", {}, "Domain name not found", {}}),
              "the name host.example has no address: Domain name not found");
}

ServiceContact contact(ServiceContact::End end, int status = 0, std::string body = {}) {
    return {end, {}, status, std::move(body)};
}

TEST(VendorService, AWrongClockIsNoVerdictOnTheNetwork) {
    using enum ServiceContact::End;
    EXPECT_TRUE(found(reachesVendor(contact(reached), {})));
    EXPECT_FALSE(found(reachesVendor(contact(failed), {true})));
    EXPECT_FALSE(found(reachesVendor(contact(badCertificate), {})));
    EXPECT_TRUE(cannotTell(reachesVendor(contact(badCertificate), {true}), Reason::badConfiguration));
    EXPECT_TRUE(
        cannotTell(retrievesFromVendor(contact(badCertificate), {}, {true}), Reason::badConfiguration));
}

TEST(VendorService, ContentMustBeTheExpectedOne) {
    using enum ServiceContact::End;
    const ExpectedContent page{"<!doctype html>"};
    EXPECT_TRUE(found(retrievesFromVendor(contact(reached, 204), page, {})));
    EXPECT_TRUE(found(retrievesFromVendor(contact(reached, 200, "<!doctype html><p>"), page, {})));
    EXPECT_FALSE(found(retrievesFromVendor(contact(reached, 200, "<html>"), page, {})));
    EXPECT_FALSE(found(retrievesFromVendor(contact(reached, 200, "anything"), {}, {})));
    EXPECT_FALSE(found(retrievesFromVendor(contact(reached, 404, "<!doctype html>"), page, {})));
    EXPECT_FALSE(found(retrievesFromVendor(contact(reached, 200, "<!doctype htm"), page, {}))) << "cut off";
    EXPECT_FALSE(found(retrievesFromVendor(contact(failed, 204), page, {})));
}

PortalAnswer brokenOff(std::size_t size) {
    PortalAnswer answer = answered(200, size);
    answer.bodyIsWhole = false;
    answer.why = "Connection reset by peer";
    return answer;
}

struct PortalCase {
    PortalAnswer plain, secure;
    char verdict;  ///< 'c' captive, 'o' not, '?' cannot tell
};

TEST(CaptivePortal, EveryRowOfTheDecisionHolds) {
    const PortalAnswer ok = answered(204), none;
    const PortalCase cases[] = {
        {answered(204), none, 'o'},
        {answered(204), ok, 'o'},
        {answered(200), ok, 'o'},
        {answered(200, 1), ok, 'o'},
        {answered(200), none, '?'},
        {answered(200, 2), ok, 'c'},
        {answered(200, 900), none, 'c'},
        {answered(302, 0, "http://portal.example/"), ok, 'c'},
        {answered(307), none, 'c'},
        {answered(511, 300), ok, 'c'},
        {answered(201), ok, 'c'},
        {answered(304), ok, 'c'},
        {answered(404, 9), ok, 'o'},
        {answered(502, 9), none, '?'},
        {brokenOff(0), ok, 'o'},
        {brokenOff(0), none, '?'},
        {brokenOff(1), none, '?'},
        {brokenOff(2), ok, 'c'},
        {answered(200), brokenOff(0), 'o'},
        {none, ok, 'o'},
        {none, answered(302), '?'},
        {none, none, '?'},
    };
    for (const PortalCase& each : cases) {
        const auto judged = judgePortal({{}, each.plain, each.secure});
        const char verdict = !judged ? '?' : judged->captive ? 'c' : 'o';
        EXPECT_EQ(verdict, each.verdict)
            << each.plain.status << " with " << each.plain.bodySize << " bytes, " << each.secure.status;
    }
}

TEST(CaptivePortal, TheNetworksOwnWordComesFirst) {
    PortalEvidence evidence{{}, answered(302, 0, "http://portal.example/"), {}};
    evidence.declared.captive = false;
    EXPECT_FALSE(judgePortal(evidence)->captive);
    evidence = {{true, std::nullopt}, answered(200, 900), {}};
    EXPECT_FALSE(judgePortal(evidence)->captive);
    evidence = {{false, true}, answered(204), answered(204)};
    EXPECT_TRUE(judgePortal(evidence)->captive);
}

TEST(CaptivePortal, AProbeHostWithAPrivateAddressThatIsSilentIsNoInternetRatherThanAPortal) {
    PortalEvidence evidence;
    evidence.plain.server = address("10.0.0.1");
    const auto judged = judgePortal(evidence);
    ASSERT_TRUE(judged);
    EXPECT_FALSE(judged->captive);
    evidence.plain = brokenOff(0);
    evidence.plain.server = address("10.0.0.1");
    EXPECT_FALSE(judgePortal(evidence)) << "it is not silent";
}

TEST(CaptivePortal, APageThatBrokeOffBeforeItBeganIsNoAnswer) {
    const auto partial = judgePortal({{}, brokenOff(0), answered(204)}),
               none = judgePortal({{}, brokenOff(0), {}});
    ASSERT_TRUE(partial);
    EXPECT_EQ(partial->why, "partial: HTTPS got through, HTTP did not");
    EXPECT_EQ(connectivityOf({{}, brokenOff(0), answered(204)}), Connectivity::partial);
    ASSERT_FALSE(none);
    EXPECT_EQ(none.error().message,
              "the page over HTTP never came, and HTTPS did not get through: Connection reset by peer");
    EXPECT_EQ(connectivityOf({{}, brokenOff(0), {}}), Connectivity::none);
}

TEST(CaptivePortal, TheJoinedNetworksRecordComesWithTheVerdict) {
    SavedNetwork home;
    home.name = nameFromText("Home").value();
    home.security = SavedSecurity::sae;
    const Known<SavedNetworks> saved = SavedNetworks{"store", {home}};
    const Known<PortalEvidence> open = PortalEvidence{{}, answered(204), {}};

    const Outcome known = isCaptive(open, saved, home.name, true);
    const Outcome unknown = isCaptive(open, failure(Reason::unavailable, "no store"), home.name, false);

    EXPECT_FALSE(found(known));
    const auto record = informationOf(known, "PreferredNetwork").asRecord<PreferredNetworkRecord>();
    ASSERT_NE(record, nullptr);
    EXPECT_EQ(record->ssid, "Home");
    EXPECT_TRUE(record->multiAP);
    EXPECT_FALSE(found(unknown));
    EXPECT_EQ(unknown->info, nullptr);
}

TEST(CaptivePortal, ANetworkThatIsNotJoinedIsAsItIsRemembered) {
    SavedNetwork cafe;
    cafe.name = nameFromText("Cafe").value();
    cafe.captive = true;
    const Known<SavedNetworks> saved = SavedNetworks{"store", {cafe}};
    EXPECT_TRUE(found(isRememberedAsCaptive(saved, cafe.name, false)));
    EXPECT_TRUE(
        cannotTell(isRememberedAsCaptive(saved, nameFromText("Other").value(), false), Reason::notFound));
}

}  // namespace
}  // namespace wp
