#include "service/security.h"

#include <gtest/gtest.h>

#include "verification/unit/service/frames.h"

namespace wp {
namespace {

constexpr std::uint8_t kRequired = 0x40;
constexpr std::uint8_t kCapable = 0x80;

/// An element that overrides the RSN element for stations that know of it.
Frame rsnOverride(std::uint8_t kind, const std::vector<std::uint8_t>& keys) {
    const Frame rsn = rsnElement(4, {4}, keys, kRequired | kCapable);
    return vendorElement(0x506F9A00 | kind, Frame(rsn.begin() + 2, rsn.end()));
}

struct SecurityCase {
    const char* wanted;
    std::uint16_t capability;
    Frame frame;
};

std::string classified(const SecurityCase& each) {
    return std::string(nameOf(securityOf(decodeSecurity(each.capability, decodeElements(each.frame)))));
}

TEST(Security, IsNamedAfterWhatIsAdvertised) {
    const SecurityCase cases[] = {
        {"Open", 0, {}},
        {"OWE Transition", 0, vendorElement(0x506F9A1C, {1})},
        {"OWE", kPrivacy, rsnElement(4, {4}, {18}, kRequired | kCapable)},
        {"OWE", kPrivacy, rsnElement(4, {4}, {18}) + vendorElement(0x506F9A1C, {1})},
        {"WEP", kPrivacy, {}},
        {"WPA Personal", kPrivacy, wpaElement({2}, {2})},
        {"WPA/WPA2 Personal", kPrivacy, wpaElement({2}, {2}) + rsnElement(2, {4, 2}, {2})},
        {"WPA2 Personal", kPrivacy, rsnElement(4, {4}, {2})},
        {"WPA2 Personal", kPrivacy, rsnElement(4, {4}, {2, 4, 6})},
        {"WPA2/WPA3 Personal", kPrivacy, rsnElement(4, {4}, {2, 8}, kCapable)},
        {"WPA3 Personal", kPrivacy, rsnElement(4, {4}, {8}, kRequired | kCapable)},
        {"WPA3 Personal", kPrivacy, rsnElement(9, {9}, {24, 25}, kRequired | kCapable)},
        {"WPA2/WPA3 Personal", kPrivacy,
         rsnElement(4, {4}, {2}) + rsnOverride(0x29, {8}) + rsnOverride(0x2A, {24})},
        {"WPA3 Personal", kPrivacy, rsnElement(4, {4}, {8}, kRequired | kCapable) + rsnOverride(0x2A, {24})},
        {"WPA Enterprise", kPrivacy, wpaElement({2}, {1})},
        {"WPA/WPA2 Enterprise", kPrivacy, wpaElement({2}, {1}) + rsnElement(2, {4}, {1})},
        {"WPA2 Enterprise", kPrivacy, rsnElement(4, {4}, {1})},
        {"WPA2 Enterprise", kPrivacy, rsnElement(4, {4}, {5}, kCapable)},
        {"WPA2/WPA3 Enterprise", kPrivacy, rsnElement(4, {4}, {1, 5}, kCapable)},
        {"WPA3 Enterprise", kPrivacy, rsnElement(4, {4}, {5}, kRequired | kCapable)},
        {"WPA3 Enterprise", kPrivacy, rsnElement(9, {9}, {12}, kRequired | kCapable)},
        {"Unknown", kPrivacy, element(68, {1, 0})},
        {"Unknown", kPrivacy, vendorElement(0x506F9A12)},
        {"Unknown", kPrivacy, rsnElement(4, {4}, {99})},
    };
    for (const SecurityCase& each : cases) EXPECT_EQ(each.wanted, classified(each));
}

TEST(Security, OfAnRsnElementThatEndsAfterTheVersionIsTheDefaultEnterprise) {
    const Frame frame = element(48, {1, 0});

    EXPECT_EQ("WPA2 Enterprise", classified({"", kPrivacy, frame}));
    EXPECT_EQ(SecuritySuites::kCcmpOrBetter, decodeSecurity(0, decodeElements(frame)).pairwise);
}

TEST(Security, IsUnknownWhenAnElementEndsWithinAField) {
    for (const Frame& body :
         {Frame{1}, Frame{1, 0, 0x00, 0x0F, 0xAC}, Frame{1, 0, 0x00, 0x0F, 0xAC, 4, 2, 0, 0, 0x0F, 0xAC, 4},
          Frame{1, 0, 0x00, 0x0F, 0xAC, 4, 0xFF, 0xFF}}) {
        const Frame frame = element(48, body);

        EXPECT_TRUE(decodeSecurity(kPrivacy, decodeElements(frame)).malformed);
        EXPECT_EQ("Unknown", classified({"", kPrivacy, frame}));
    }
}

TEST(Security, IsUnknownWhenTheElementsBreakOffBeforeAnyOfSecurity) {
    const Frame cut = nameElement("Home") + Frame{48, 20, 1, 0};
    for (const std::uint16_t capability : {std::uint16_t{0}, kPrivacy})
        EXPECT_EQ("Unknown", classified({"", capability, cut}));
    EXPECT_EQ("WPA2 Personal", classified({"", kPrivacy, rsnElement(4, {4}, {2}) + cut}));
}

TEST(Security, IsKnownWhereOneOfTwoFramesIsWhole) {
    const Frame whole = nameElement("Home");
    const Frame cut = whole + Frame{48, 20, 1, 0};
    for (const auto& says :
         {decodeAdvertised(kPrivacy, whole, Bytes(cut)), decodeAdvertised(kPrivacy, cut, Bytes(whole))}) {
        EXPECT_EQ(Security::wep, securityOf(says.security));
        EXPECT_TRUE(says.malformed);
    }
    EXPECT_EQ(Security::unknown, securityOf(decodeAdvertised(kPrivacy, cut, Bytes(cut)).security));
}

TEST(Security, OfAPasswordWithSaeBesideItIsOneKindWithEither) {
    EXPECT_EQ(classOf(Security::wpa2Personal), classOf(Security::mixedWpa2Wpa3Personal));
    EXPECT_EQ(classOf(Security::wpa3Personal), classOf(Security::mixedWpa2Wpa3Personal));
    EXPECT_NE(classOf(Security::wpa2Personal), classOf(Security::wpa2Enterprise));
    EXPECT_NE(classOf(Security::open), classOf(Security::owe));
}

}  // namespace
}  // namespace wp
