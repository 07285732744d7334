#include "linux/config.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include "platform/json_writer.h"
#include "verification/unit/fakes/temporary_folder.h"
#include "verification/unit/places.h"

namespace wp {
namespace {

/// The refusal's line; empty where the text is taken.
std::string refusalOf(const std::string& json) {
    Config config = Config::defaults();
    const auto refusal = applyConfig(json, config);
    return refusal ? refusal->text() : "";
}

TEST(Config, TakesOverWhatIsSetAndKeepsTheRest) {
    Config config = Config::defaults();
    const auto refusal = applyConfig(R"({
        "capabilities": {"wapi": true},
        "endpoints": {"pingIPv4": "192.0.2.1", "stun": "", "vendorHost": "[2001:db8::1]:8443"},
        "thresholds": {"savedNetworks": 2, "channelLoad": 0.25, "overlap": 2},
        "vendors": {"baseStation": {"manufacturers": ["A", "B"], "addressPrefixes": ["02:1A:2b"]},
                    "hotspot": {"vendorElements": [{"prefix": "00:11:22"}, {"prefix": "00:11:22", "type": 7}],
                                "addressPrefixes": ["02:1A:11:22"], "leaseTexts": []},
                    "commonNames": ["Lobby", "a\\xFF"], "peerLinkIndicator": "/run/peer"}})",
                                     config);
    ASSERT_FALSE(refusal) << refusal->text();
    EXPECT_EQ(config.endpoints.pingIPv4, "192.0.2.1");
    EXPECT_EQ(config.endpoints.pingIPv6, Endpoints().pingIPv6);
    EXPECT_EQ(config.endpoints.stun, "");
    EXPECT_EQ(config.thresholds.saved.count, 2U);
    EXPECT_EQ(config.thresholds.bluetooth.paired, BluetoothLimits().paired);
    EXPECT_DOUBLE_EQ(config.thresholds.congestion.load, 0.25);
    EXPECT_DOUBLE_EQ(config.thresholds.congestion.overlap, 2.0);
    EXPECT_EQ(config.vendors.baseStation.manufacturers, (std::vector<std::string>{"A", "B"}));
    EXPECT_EQ(config.vendors.baseStation.prefixes, (std::vector<VendorPrefix>{{0x02, 0x1A, 0x2B}}));
    ASSERT_EQ(config.vendors.hotspot.elements.size(), 2U);
    EXPECT_EQ(config.vendors.hotspot.elements[0].type, std::nullopt);
    EXPECT_EQ(config.vendors.hotspot.elements[1].type, 7);
    EXPECT_TRUE(config.vendors.hotspot.leaseTexts.empty());
    EXPECT_EQ(config.vendors.commonNames, (std::vector{*nameFromText("Lobby"), *nameFromText("a\\xFF")}));
    EXPECT_EQ(config.peerLinkIndicator, "/run/peer");
}

TEST(Config, ARefusalSaysWhereAndWhyAndChangesNothing) {
    EXPECT_EQ(refusalOf(R"({"endpoints": {"pingIPv4": "::1"}})"),
              "endpoints.pingIPv4: must be an IPv4 address");
    EXPECT_EQ(refusalOf(R"({"endpoints": {"portalSecure": "http://a/"}})"),
              "endpoints.portalSecure: must begin with https://");
    EXPECT_EQ(refusalOf(R"({"endpoints": {"stun": "host"}})"), "endpoints.stun: must be HOST:PORT");
    EXPECT_EQ(refusalOf(R"({"vendors": {"hotspot": {"addressPrefixes": ["02:1A:1"]}}})"),
              "vendors.hotspot.addressPrefixes[0]: must be octets such as 02:00:5E");
    const std::string badName = "vendors.commonNames[1]: must be a network's name of 1 to 32 bytes";
    EXPECT_EQ(refusalOf(R"({"vendors": {"commonNames": ["a", ""]}})"), badName);
    EXPECT_EQ(refusalOf(R"({"vendors": {"commonNames": ["a", ")" + std::string(33, 'b') + R"("]}})"),
              badName);
    for (const char* json :
         {"", "[]", "{\"other\": 1}", R"({"endpoints": {"ping": ""}})", R"({"endpoints": 1})",
          R"({"endpoints": {"name": "a b"}})", R"({"thresholds": {"savedNetworks": -1}})",
          R"({"thresholds": {"savedNetworks": 1.5}})", R"({"thresholds": {"channelLoad": 0}})",
          R"({"thresholds": {"channelLoad": 1.01}})", R"({"vendors": {"baseStation": {"x": []}}})",
          R"({"vendors": {"baseStation": {"addressPrefixes": ["02:1A:11:22"]}}})",
          R"({"vendors": {"baseStation": {"addressPrefixes": ["02:1A:11:"]}}})",
          R"({"vendors": {"hotspot": {"vendorElements": [{"type": 1}]}}})",
          R"({"vendors": {"hotspot": {"vendorElements": [{"prefix": "02:1A:11", "type": 256}]}}})"})
        EXPECT_NE(refusalOf(json), "") << json;

    Config config = Config::defaults();
    applyConfig(R"({"endpoints": {"pingIPv4": "192.0.2.1"}, "thresholds": 7})", config);
    EXPECT_EQ(config.endpoints.pingIPv4, Endpoints().pingIPv4);
}

std::string told(const Config& config) {
    return jsonText(toldOf(config), JSONStyle::compact);
}

TEST(Config, WhatTheHostIsToldIsAConfigurationItself) {
    Config shown = Config::defaults();
    shown.endpoints.pingIPv4 = "192.0.2.1";
    Config read = Config::defaults();
    const auto refusal = applyConfig(told(shown), read);
    ASSERT_FALSE(refusal) << refusal->text();
    EXPECT_EQ(read.endpoints.pingIPv4, "192.0.2.1");
    EXPECT_EQ(read.endpoints.vendorUrl, Endpoints().vendorUrl);
}

TEST(Config, CapabilitiesAreTakenOverOneByOne) {
    Config config = Config::defaults();
    EXPECT_FALSE(applyConfig(R"({"capabilities": {"wapi": false, "other": true}})", config));
    EXPECT_FALSE(
        applyConfig(R"({"capabilities": {"wapi": true}, "thresholds": {"channelLoad": 0.25}})", config));
    EXPECT_EQ(config.capabilities, (Flags{{"other", true}, {"wapi", true}}));
    Config read = Config::defaults();
    EXPECT_FALSE(applyConfig(told(config), read));
    EXPECT_EQ(read.capabilities, config.capabilities);
    EXPECT_EQ(read.thresholds.congestion.load, 0.25);
    EXPECT_EQ(told(read), told(config));
    EXPECT_EQ(refusalOf(R"({"capabilities": {"wapi": 1}})"), "capabilities.wapi: must be true or false");
}

TEST(Config, WhereTheyLieIsTheSystemsFirstAndTheUsersLast) {
    EXPECT_EQ(configFiles("/home/a/.config"),
              (std::vector<std::string>{"/etc/wifi-profile/vendors.json", "/etc/wifi-profile/config.json",
                                        "/home/a/.config/wifi-profile/config.json"}));
}

TEST(Config, TheDataFileForMakersThatShipsSetsWhatHoldsWithoutIt) {
    Config config;
    std::ifstream file(sourceFolder() + "/resources/vendors.json");
    const std::string text{std::istreambuf_iterator<char>(file), {}};
    ASSERT_FALSE(text.empty());
    const auto refusal = applyConfig(text, config);
    EXPECT_FALSE(refusal) << refusal->text();
    const Vendors shipped = config.vendors, built = Config::defaults().vendors;
    EXPECT_EQ(shipped.commonNames, built.commonNames);
    EXPECT_EQ(shipped.baseStation.manufacturers, built.baseStation.manufacturers);
    EXPECT_EQ(shipped.hotspot.addressPrefixes, built.hotspot.addressPrefixes);
    EXPECT_EQ(shipped.hotspot.leaseTexts, built.hotspot.leaseTexts);
}

TEST(Config, LaterFilesWinAndOnlyTheNamedOneMustBeThere) {
    const fakes::TemporaryFolder temporary;
    const std::string& folder = temporary.path();
    std::ofstream(folder + "/a") << R"({"endpoints": {"name": "a.example", "nameWildcard": "w.example"}})";
    std::ofstream(folder + "/b") << R"({"endpoints": {"name": "b.example"}})";
    std::ofstream(folder + "/bad") << R"({"endpoints": {"name": 1}})";

    const auto both = loadConfig({folder + "/a", folder + "/none"}, folder + "/b");
    const auto missing = loadConfig({folder + "/a"}, folder + "/none");
    const auto bad = loadConfig({folder + "/bad", folder + "/a"}, "");

    ASSERT_TRUE(std::holds_alternative<Config>(both));
    EXPECT_EQ(std::get<Config>(both).endpoints.name, "b.example");
    EXPECT_EQ(std::get<Config>(both).endpoints.nameWildcard, "w.example");
    EXPECT_EQ(std::get<std::string>(missing), folder + "/none: cannot be read: No such file or directory");
    EXPECT_TRUE(std::get<std::string>(bad).starts_with(folder + "/bad: endpoints.name: "))
        << std::get<std::string>(bad);
}

TEST(Config, AFileThatIsThereAndCannotBeTakenIsNotPassedOver) {
    const fakes::TemporaryFolder temporary;
    const std::string& folder = temporary.path();
    std::ofstream(folder + "/long") << std::string((1U << 20) + 1, ' ');
    std::filesystem::create_directory(folder + "/config.json");

    for (const char* name : {"/long", "/config.json"})
        EXPECT_EQ(std::get<std::string>(loadConfig({folder + name}, "")),
                  folder + name + ": is no regular file of at most 1 MiB");
    std::filesystem::create_symlink(folder + "/loop", folder + "/loop");
    EXPECT_EQ(std::get<std::string>(loadConfig({folder + "/loop"}, "")),
              folder + "/loop: cannot be read: Too many levels of symbolic links");
}

}  // namespace
}  // namespace wp
