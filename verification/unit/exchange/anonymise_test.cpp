#include "exchange/anonymise.h"

#include <gtest/gtest.h>

#include "exchange/anonymous_addresses.h"
#include "exchange/anonymous_names.h"
#include "platform/json_writer.h"
#include "platform/records.h"
#include "verification/unit/exchange/recordings.h"

namespace wp {
namespace {

TEST(Anonymise, ReplacesNamesAndAddressesThroughoutARecording) {
    Recording original = std::get<Recording>(loadRecording(kFolder + "neighbourhood.json"));

    std::string text = recordingText(anonymised(original));

    EXPECT_EQ(text,
              recordingText(std::get<Recording>(loadRecording(kFolder + "neighbourhood_anonymised.json"))));
    for (const char* secret : {"Ann", "Zed", "café", "Typed", "aa:bb", "AA:BB", "aa-bb", "8.8.8.8", "1.1.1.1",
                               "9.9.9.9", "2a00", "ccff"})
        EXPECT_EQ(text.find(secret), std::string::npos) << secret;
}

TEST(Anonymise, ReplacesNamesAndAddressesInDetailsButNoOtherWord) {
    const auto network = Dictionary::make(
        {{"ssid", "redirect"}, {"bssid", "aa:bb:cc:dd:ee:ff"}, {"security", "WPA2 Personal"}});
    const auto details = Dictionary::make({{"networks", Array{network}},
                                           {"kind", "redirect"},
                                           {"url", "http://login.hotel-rose.example/?mac=AABBCCDDEEFF"},
                                           {"hops", Array{"81.2.3.4", Value()}}});
    Recording recording;
    recording.answers.emplace_back();
    recording.answers[0].test = 24;
    recording.answers[0].response.results =
        DiagnosticsTestResults{std::make_shared<DiagnosticsTestResult>(DiagnosticsTestResult{
            true, false, Dictionary::make({{"Details", details}, {"NetworkName", "redirect"}})})};

    const Recording without = anonymised(recording);

    EXPECT_EQ(
        jsonText(without.answers[0].response.results->front()->info, JSONStyle::compact),
        R"({"Details":{"hops":["198.18.0.1",null],"kind":"redirect","networks":[{"bssid":"02:00:00:00:00:01",)"
        R"("security":"WPA2 Personal","ssid":"Net 0001"}],"url":"http://portal.example/"},)"
        R"("NetworkName":"Net 0001"})");
}

TEST(Anonymise, LeavesNothingOfAPortalsPageButItsScheme) {
    const auto pageOf = [](const char* url) {
        Recording recording;
        recording.answers.emplace_back();
        const auto info = Dictionary::make({{"Details", Dictionary::make({{"url", url}})}});
        recording.answers[0].response.results = DiagnosticsTestResults{
            std::make_shared<DiagnosticsTestResult>(DiagnosticsTestResult{true, false, info})};
        return jsonText(anonymised(recording).answers[0].response.results->front()->info, JSONStyle::compact);
    };
    EXPECT_EQ(pageOf("https://rose.example/a"), R"({"Details":{"url":"https://portal.example/"}})");
    EXPECT_EQ(pageOf("/rose?room=12&to=http://x"), R"({"Details":{"url":"portal.example/"}})");
}

TEST(Anonymise, LeavesTheOriginalAlone) {
    Recording original = std::get<Recording>(loadRecording(kFolder + "neighbourhood.json"));
    std::string before = recordingText(original);
    anonymised(original);
    EXPECT_EQ(recordingText(original), before);
}

TEST(Anonymise, NumbersNamesAsTheySortAndKeepsTheirLengthApart) {
    AnonymousNames names({"", "zoo", "Alpha", "beta network", "Gamma, a network with a name", "x_noMAP"});

    EXPECT_EQ(names.replaced("Alpha"), "Net 0001");
    EXPECT_EQ(names.replaced("beta network"), "Net 0002 nearby");
    EXPECT_EQ(names.replaced("Gamma, a network with a name"), "Net 0003 with a long name");
    EXPECT_EQ(names.replaced("x_noMAP"), "Net 0004_noMAP");
    EXPECT_EQ(names.replaced("zoo"), "Net 0005");
    EXPECT_EQ(names.replaced("alpha"), "alpha");
    EXPECT_EQ(names.replaced(""), "");
}

TEST(Anonymise, ReplacesNamesInSentencesOnlyAsWords) {
    AnonymousNames names({"Home", "Home Office", "is", "東京"});

    EXPECT_EQ(names.replacedWithin("'Home Office' is not Home, nor Homes"),
              "'Net 0002 nearby' is not Net 0001, nor Homes");
    EXPECT_EQ(names.replacedWithin("<東京>"), "<Net 0004>");
}

TEST(Anonymise, GivesTheSameAddressTheSameReplacement) {
    AnonymousAddresses addresses;

    EXPECT_EQ(addresses.hardwareAddress("aa:bb:cc:dd:ee:ff"), "02:00:00:00:00:01");
    EXPECT_EQ(addresses.hardwareAddress("00:11:22:33:44:55"), "02:00:00:00:00:02");
    EXPECT_EQ(addresses.hardwareAddress("AA:BB:CC:DD:EE:FF"), "02:00:00:00:00:01");
    EXPECT_EQ(addresses.replacedWithin("AP aa-bb-cc-dd-ee-ff, or 00:11:22:33:44:55."),
              "AP 02-00-00-00-00-01, or 02:00:00:00:00:02.");
    EXPECT_EQ(addresses.hardwareAddress("ff:ff:ff:ff:ff:ff"), "ff:ff:ff:ff:ff:ff");
    EXPECT_EQ(addresses.hardwareAddress("not an address"), "02:00:00:00:00:03");
    EXPECT_EQ(addresses.hardwareAddress(""), "");
}

TEST(Anonymise, ReplacesPublicIPAddressesAndKeepsPrivateOnes) {
    AnonymousAddresses addresses;

    EXPECT_EQ(addresses.replacedWithin("8.8.8.8, 8.8.4.4/24 and 8.8.8.8:53."),
              "198.18.0.1, 198.18.0.2/24 and 198.18.0.1:53.");
    for (const char* kept : {"192.168.0.1", "10.1.2.3", "172.16.0.1", "127.0.0.1", "169.254.1.1", "0.0.0.0",
                             "224.0.0.1", "255.255.255.0", "100.64.0.1", "::", "::1", "ff02::1"})
        EXPECT_EQ(addresses.replacedWithin(kept), kept);
    EXPECT_EQ(addresses.replacedWithin("fe80::1%wlan0"), "fe80::1%wlan0");
    EXPECT_EQ(addresses.replacedWithin("[2a00:1450:0::9]:443"), "[2001:db8::2]:443");
    EXPECT_EQ(addresses.replacedWithin("fd12:3456::1"), "fd00::3");
}

TEST(Anonymise, ReplacesTheHardwareAddressInTheNameOfAnInterface) {
    AnonymousAddresses addresses;

    EXPECT_EQ(addresses.replacedWithin("wlx1c61b4a1b2c3 (1c:61:b4:a1:b2:c3), enx00e04c680001: down"),
              "wlx020000000001 (02:00:00:00:00:01), enx020000000002: down");
    for (const char* kept :
         {"wlan0", "wlp3s0", "enx00e04c68000", "enx00e04c680001a", "awlx1c61b4a1b2c3", "wlx1c61b4a1b2cg"})
        EXPECT_EQ(addresses.replacedWithin(kept), kept);
}

TEST(Anonymise, ReplacesNamesOfInterfacesWhereverTheyStand) {
    auto pinged = std::make_shared<PingStatistics>();
    pinged->interfaceName = "wlx1c61b4a1b2c3";
    Recording recording;
    recording.description = "wlx1c61b4a1b2c3 at home";
    recording.wifi.devices = {"wlx1c61b4a1b2c3", "wlan1"};
    recording.answers.emplace_back();
    recording.answers[0].response.error = Error{1, "enx1c61b4a1b2c3 is down"};
    recording.answers[0].response.results =
        DiagnosticsTestResults{std::make_shared<DiagnosticsTestResult>(DiagnosticsTestResult{
            true, true,
            Dictionary::make({{"PingResult", pinged},
                              {"Details", Dictionary::make({{"links", Array{"wlx1c61b4a1b2c3"}}})}})})};

    const Recording without = anonymised(recording);

    EXPECT_EQ(without.wifi.devices, (std::vector<std::string>{"wlx020000000001", "wlan1"}));
    EXPECT_EQ(recordingText(without).find("1c61b4a1b2c3"), std::string::npos) << recordingText(without);
    EXPECT_EQ(recordingText(without), recordingText(anonymised(without)));
}

TEST(Anonymise, ReplacesNamesInTheMiddleOfAnInfoText) {
    Recording recording;
    auto joined = std::make_shared<WiFiStatus>();
    joined->ssid = "Office";
    recording.status = {{joined, std::nullopt}};
    recording.answers.emplace_back();
    recording.answers[0].response.results =
        DiagnosticsTestResults{std::make_shared<DiagnosticsTestResult>(DiagnosticsTestResult{
            true, true, Dictionary::make({{"Text", "The Office net"}, {"Security", "Office"}})})};

    const Recording without = anonymised(recording);

    EXPECT_EQ(jsonText(without.answers[0].response.results->front()->info, JSONStyle::compact),
              R"({"Security":"Office","Text":"The Net 0001 net"})");
}

TEST(Anonymise, TakesNamesThatItIsToldForNetworksToo) {
    Recording recording;
    recording.description = "Loft beside Cellar";

    EXPECT_EQ(anonymised(recording, {"Loft", "Cellar"}).description, "Net 0002 beside Net 0001");
    EXPECT_EQ(anonymised(recording).description, "Loft beside Cellar");
}

TEST(Anonymise, FindsAddressesInEveryFormAndBesideOtherWords) {
    AnonymousAddresses addresses;

    EXPECT_EQ(
        addresses.replacedWithin("mac:aa:bb:cc:dd:ee:ff AABB.CCDD.EEFF aabbccddeeff aa-bb-cc-dd-ee-ff-wlan0"),
        "mac:02:00:00:00:00:01 0200.0000.0001 020000000001 02-00-00-00-00-01-wlan0");
    EXPECT_EQ(addresses.replacedWithin("/run/p2p-dev-wlxAABBCCDDEEFF.lease"),
              "/run/p2p-dev-wlx020000000001.lease");
    EXPECT_EQ(addresses.replacedWithin("gateway:8.8.8.8 host-8.8.8.8 8.8.4.4-8.8.8.8 ns.8.8.8.8 ip_8.8.8.8_"),
              "gateway:198.18.0.1 host-198.18.0.1 198.18.0.2-198.18.0.1 ns.198.18.0.1 ip_198.18.0.1_");
    EXPECT_EQ(addresses.replacedWithin("to:2a00::1-2a00::2, ::ffff:8.8.8.8:53 2a00::1:"),
              "to:2001:db8::1-2001:db8::2, ::ffff:198.18.0.1:53 2001:db8::1:");
}

TEST(Anonymise, ReplacesNamesInTheWordsWithWhichAServerRefused) {
    Recording recording;
    auto joined = std::make_shared<WiFiStatus>();
    joined->ssid = "Rose Hotel";
    recording.status.emplace_back().status = joined;
    recording.answers.emplace_back();
    recording.answers[0].response.results =
        DiagnosticsTestResults{std::make_shared<DiagnosticsTestResult>(DiagnosticsTestResult{
            true, false, Dictionary::make({{"Details", Dictionary::make({{"why", "of Rose Hotel: no"}})}})})};

    std::string text = recordingText(anonymised(recording));

    EXPECT_NE(text.find(R"("why": "of Net 0001 nearby: no")"), std::string::npos) << text;
}

TEST(Anonymise, TakesNothingElseForAnAddress) {
    AnonymousAddresses addresses;
    for (const char* text : {"802.11ac", "1.2.3", "12:30:45", "dead beef", "x02:00:00:00:00:01", "8.8.8.8x",
                             "02:00:00:00:00:01:02", "version 6.1.0-13", "v1.2.3.4.5", "cafés", "2024-05-01", "face::g"})
        EXPECT_EQ(addresses.replacedWithin(text), text);
}

}  // namespace
}  // namespace wp
