#include "service/network_tests.h"

#include "verification/unit/service/frames.h"
#include "verification/unit/service/verdict.h"

namespace wp {
namespace {

const Frame kHome = nameElement("Northlight") + element(5, {0, 2, 0, 0}) + rsnElement(4, {4}, {2});

TEST(NetworkTests, FindABeaconIntervalLongFrom111UnitsOn) {
    Facts facts = joinedTo({heard(kHome)});

    facts.link->joined->beaconInterval = 110;
    EXPECT_FALSE(resultOf(34, facts));
    EXPECT_EQ(Value(110), infoOf(34, facts, "BeaconInterval"));
    facts.link->joined->beaconInterval = 111;
    EXPECT_TRUE(resultOf(34, facts));
    EXPECT_FALSE(verdictOf(34, facts)->didPass);
}

TEST(NetworkTests, RefuseABeaconIntervalOfZero) {
    Facts facts = joinedTo({heard(kHome)});
    facts.link->joined->beaconInterval = 0;

    EXPECT_EQ(10, errorOf(34, facts));
}

TEST(NetworkTests, TakeTheDtimPeriodFromTheLinkBeforeTheBeacon) {
    Facts facts = joinedTo({heard(kHome)});
    EXPECT_EQ(Value(2), infoOf(35, facts, "DTIMInterval"));
    EXPECT_FALSE(resultOf(35, facts));

    facts.station = Station{{-50}, 4, 100};

    EXPECT_EQ(Value(4), infoOf(35, facts, "DTIMInterval"));
    EXPECT_TRUE(resultOf(35, facts));
}

TEST(NetworkTests, TakeTheDtimPeriodFromTheBeaconWhereTheDriverKnowsNone) {
    Facts facts = joinedTo({heard(kHome)});
    facts.station = Station{{-50}, 0, 100};

    EXPECT_EQ(Value(2), infoOf(35, facts, "DTIMInterval"));
}

TEST(NetworkTests, RefuseADtimPeriodOfZeroInTheBeacon) {
    EXPECT_EQ(10, errorOf(35, joinedTo({heard(element(5, {0, 0, 0, 0}))})));
}

TEST(NetworkTests, CallADtimPeriodOf3Usual) {
    EXPECT_FALSE(resultOf(35, joinedTo({heard(element(5, {0, 3, 0, 0}))})));
}

TEST(NetworkTests, CannotTellTheDtimPeriodWithoutABeacon) {
    EXPECT_EQ(5, errorOf(35, joinedTo({heard(nameElement("Northlight"))})));
}

TEST(NetworkTests, NameTheSecurityInAllThreeTests) {
    const Facts facts = joinedTo({heard(kHome, 2412, -50, kPrivacy)});

    for (const int test : {38, 39, 40}) {
        EXPECT_EQ(Value("WPA2 Personal"), infoOf(test, facts, "Security"));
        EXPECT_FALSE(resultOf(test, facts));
        EXPECT_TRUE(verdictOf(test, facts)->didPass);
    }
}

TEST(NetworkTests, TellOpenFromEncryptedWithoutAPassword) {
    EXPECT_TRUE(resultOf(38, joinedTo({heard(nameElement("Cafe"))})));
    EXPECT_TRUE(resultOf(38, joinedTo({heard(nameElement("Cafe") + vendorElement(0x506F9A1C))})));
    EXPECT_FALSE(
        resultOf(38, joinedTo({heard(nameElement("Cafe") + rsnElement(4, {4}, {18}), 2412, -50, kPrivacy)})));
}

TEST(NetworkTests, FindWepByItselfAndAsACipher) {
    EXPECT_TRUE(resultOf(39, joinedTo({heard(nameElement("Old"), 2412, -50, kPrivacy)})));
    EXPECT_TRUE(resultOf(39, joinedTo({heard(rsnElement(5, {4}, {2}), 2412, -50, kPrivacy)})));
    EXPECT_FALSE(resultOf(39, joinedTo({heard(element(68, {1, 0}), 2412, -50, kPrivacy)})));
}

TEST(NetworkTests, FindWpaByItsElementAndByItsCipher) {
    EXPECT_TRUE(resultOf(40, joinedTo({heard(wpaElement({2}, {2}), 2412, -50, kPrivacy)})));
    EXPECT_TRUE(resultOf(40, joinedTo({heard(rsnElement(2, {2, 4}, {2}), 2412, -50, kPrivacy)})));
    EXPECT_FALSE(resultOf(40, joinedTo({heard(rsnElement(2, {4}, {2}), 2412, -50, kPrivacy)})));
}

TEST(NetworkTests, DoNotClearANetworkByASecurityElementThatBreaksOff) {
    const Facts facts = joinedTo({heard(element(48, {1, 0, 0}), 2412, -50, kPrivacy)});

    EXPECT_EQ(10, errorOf(39, facts));
    EXPECT_EQ(10, errorOf(40, facts));
    EXPECT_FALSE(resultOf(38, facts));
    EXPECT_EQ(Value("Unknown"), infoOf(38, facts, "Security"));
}

TEST(NetworkTests, FindANameAmbiguousThatRoutersShipWith) {
    const auto isAmbiguous = [](std::string_view name) {
        Facts facts = joinedTo({heard(nameElement(name))});
        facts.settings.vendors.commonNames = {*nameFromText("lobby"), *nameFromText("NetGear")};
        return resultOf(42, facts);
    };
    EXPECT_TRUE(isAmbiguous("Lobby"));
    EXPECT_TRUE(isAmbiguous("netgeaR"));
    EXPECT_FALSE(isAmbiguous("Netgear2"));
    EXPECT_FALSE(isAmbiguous("lobb"));
}

TEST(NetworkTests, FindANameAmbiguousThatTwoNetworksShare) {
    const AccessPoint home = heard(kHome, 2412, -50, kPrivacy);
    const AccessPoint sae = heard(nameElement("Northlight") + rsnElement(4, {4}, {8}), 5180, -50, kPrivacy);
    const AccessPoint open = heard(nameElement("Northlight"));

    EXPECT_FALSE(resultOf(42, joinedTo({home, sae})));
    EXPECT_TRUE(resultOf(42, joinedTo({home, sae, open})));
    EXPECT_EQ(Value("Northlight"), infoOf(42, joinedTo({home}), "NetworkName"));
}

TEST(NetworkTests, FindANameHiddenByTheBeaconAlone) {
    const Frame answer = nameElement("Secret");
    AccessPoint secret = heard(answer);

    for (const Frame& beacon :
         {nameElement(""), nameElement(std::string_view("\0\0\0\0\0\0", 6)), nameElement(" ")}) {
        secret.says = decodeAdvertised(0, answer, Bytes(beacon));
        EXPECT_TRUE(resultOf(43, joinedTo({secret})));
        EXPECT_EQ(Value("Secret"), infoOf(42, joinedTo({secret}), "NetworkName"));
    }
    EXPECT_FALSE(resultOf(43, joinedTo({heard(nameElement(" "))})));
}

TEST(NetworkTests, CannotTellAHiddenNameFromAnAnswerWithAName) {
    AccessPoint answered = heard({});
    answered.says = decodeAdvertised(0, nameElement("Northlight"), std::nullopt);

    EXPECT_EQ(5, errorOf(43, joinedTo({answered})));
}

TEST(NetworkTests, CannotTellASecurityBeforeWhichTheElementsBreakOff) {
    const Frame cut = nameElement("Home") + Frame{48, 20, 1, 0};
    const Facts hidden = joinedTo({heard(cut, 2412, -50, kPrivacy)});
    EXPECT_FALSE(resultOf(38, hidden));
    EXPECT_EQ(10, errorOf(39, hidden));
    EXPECT_EQ(10, errorOf(40, hidden));
    EXPECT_EQ(10, errorOf(38, joinedTo({heard(cut)})));
}

TEST(NetworkTests, TellAHotspotFromItsSignUpNetwork) {
    EXPECT_TRUE(resultOf(45, joinedTo({heard(vendorElement(0x506F9A10, {0}))})));
    EXPECT_FALSE(resultOf(45, joinedTo({heard(vendorElement(0x506F9A10, {0}) + vendorElement(0x506F9A12))})));
    EXPECT_FALSE(resultOf(45, joinedTo({heard(element(107, {0x12}))})));
}

TEST(NetworkTests, JudgeTheStrongestOfTheNamedNetwork) {
    const AccessPoint far = heard(nameElement("Office"), 2412, -80);
    const AccessPoint near = heard(nameElement("Office") + rsnElement(4, {4}, {2}), 5180, -40, kPrivacy);

    EXPECT_FALSE(resultOf(38, askedAbout("Office", {far, near})));
}

TEST(NetworkTests, SayWhyWhenThereIsNothingToJudge) {
    const Facts unseen = askedAbout("Office", {heard(kHome)});
    Facts unjoined = joinedTo({heard(kHome)});
    unjoined.link->joined.reset();
    Facts forbidden = unseen;
    forbidden.nearby = failure(Reason::notPermitted, "no permission to scan");

    for (const int test : {34, 35, 36, 37, 38, 39, 40, 41, 42, 43, 45, 27, 28, 32}) {
        EXPECT_EQ(3, errorOf(test, unseen)) << test;
        EXPECT_EQ(2, errorOf(test, unjoined)) << test;
        EXPECT_EQ(6, errorOf(test, forbidden)) << test;
    }
}

}  // namespace
}  // namespace wp
