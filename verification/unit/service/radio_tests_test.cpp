#include "service/radio_tests.h"

#include "verification/unit/service/frames.h"
#include "verification/unit/service/verdict.h"

namespace wp {
namespace {

const Frame kName = nameElement("Northlight");
const Frame kHt = element(45, Frame(26, 0));
const Frame kVht = element(191, Frame(12, 0));

Frame country(std::string_view code) {
    return element(7, Frame(code.begin(), code.end()) + Frame{' ', 1, 13, 20});
}
Frame htOperation(std::uint8_t second) {
    return element(61, {6, second, 0});
}

TEST(RadioTests, FindFortyMegahertzByTheSecondChannelAlone) {
    EXPECT_TRUE(resultOf(27, joinedTo({heard(kName + htOperation(1))})));
    EXPECT_TRUE(resultOf(27, joinedTo({heard(kName + htOperation(7))})));
    EXPECT_FALSE(resultOf(27, joinedTo({heard(kName + htOperation(4))})));
    EXPECT_FALSE(resultOf(27, joinedTo({heard(kName)})));
    EXPECT_FALSE(resultOf(27, joinedTo({heard(kName + htOperation(5), 5180)})));
}

TEST(RadioTests, FindACountryThatContradictsTheAdoptedOne) {
    Facts facts = joinedTo({heard(kName + country("DE"))});
    facts.regulation = Regulation{"US"};

    EXPECT_TRUE(resultOf(28, facts));
    EXPECT_EQ(Value("US"), infoOf(28, facts, "AdoptedCountryCode"));
    facts.regulation = Regulation{"DE"};
    EXPECT_FALSE(resultOf(28, facts));
}

TEST(RadioTests, TakeTheWorldForNoCountry) {
    Facts facts = joinedTo({heard(kName + country("DE"))});
    for (const char* world : {"00", "99", "98", "XX"}) {
        facts.regulation = Regulation{world};
        EXPECT_FALSE(resultOf(28, facts));
        EXPECT_EQ(Value(world), infoOf(28, facts, "AdoptedCountryCode"));
    }
}

TEST(RadioTests, WantTwoStrongWitnessesOfAnotherCountry) {
    const AccessPoint home = heard(kName + country("US"));
    const AccessPoint one = heard(nameElement("A") + country("DE"), 2412, -60);
    const AccessPoint two = heard(nameElement("B") + country("de"), 2412, -85);
    const AccessPoint faint = heard(nameElement("C") + country("DE"), 2412, -86);
    const AccessPoint letters = heard(nameElement("D") + country("1!"), 2412, -30);
    const auto verdict = [&](std::vector<AccessPoint> nearby) {
        Facts facts = joinedTo(std::move(nearby));
        facts.regulation = Regulation{"US"};
        return resultOf(28, facts);
    };

    EXPECT_FALSE(verdict({home, one}));
    EXPECT_FALSE(verdict({home, one, faint}));
    EXPECT_FALSE(verdict({home, one, letters}));
    EXPECT_TRUE(verdict({home, one, two}));
    AccessPoint node = two;
    node.directOnly = true;
    EXPECT_FALSE(verdict({home, one, node})) << "no access point";
}

TEST(RadioTests, TakeCodesOfNoCountryForNone) {
    const auto verdict = [](const Frame& element) {
        Facts facts = joinedTo({heard(kName + element)});
        facts.regulation = Regulation{"US"};
        return resultOf(28, facts);
    };
    for (const char* code : {"XZ", "XX", "ZZ", "AA", "QM", "EU", "00"})
        EXPECT_FALSE(verdict(country(code))) << code;
    for (const char* code : {"XK", "QA", "ZA", "AE", "GB"}) EXPECT_TRUE(verdict(country(code))) << code;
    EXPECT_FALSE(verdict(element(7, {'D', 'E', 'X', 1, 13, 20})));
    EXPECT_TRUE(verdict(element(7, {'D', 'E', 'O', 1, 13, 20})));
    EXPECT_TRUE(verdict(element(7, {'D', 'E', 4, 1, 13, 20})));
}

TEST(RadioTests, CannotTellAboutCountriesWithoutTheAdoptedOne) {
    Facts facts = joinedTo({heard(kName + country("DE"))});
    facts.regulation = failure(Reason::unavailable, "no regulatory domain");

    EXPECT_EQ(4, errorOf(28, facts));
}

TEST(RadioTests, TakeTheLoadThatTheJoinedAccessPointAnnouncedLast) {
    const auto loaded = [](std::uint8_t load) { return kName + element(11, {1, 0, load, 0, 0}); };
    Facts facts = joinedTo({heard(loaded(200))});
    facts.link->joined->says = heard(loaded(20)).says;
    EXPECT_TRUE(resultOf(24, facts));

    facts.link->joined->lastSeen = 5000;
    facts.nearby->front().lastSeen = 4999;
    EXPECT_FALSE(resultOf(24, facts));
    facts.nearby->front().lastSeen = 5001;
    EXPECT_TRUE(resultOf(24, facts));
    facts.nearby = failure(Reason::timeout, "no scan");
    EXPECT_FALSE(resultOf(24, facts));
}

TEST(RadioTests, FindASignalPoorBelowMinus75) {
    Facts facts = joinedTo({heard(kName)});
    facts.station = Station{{-75}, {}, {}};
    EXPECT_FALSE(resultOf(32, facts));
    facts.station = Station{{-76}, {}, {}};
    EXPECT_TRUE(resultOf(32, facts));
    EXPECT_EQ(Value(-76), infoOf(32, facts, "RSSI"));
}

TEST(RadioTests, TakeTheMiddleOfTheSamples) {
    Facts facts = joinedTo({heard(kName)});
    facts.station = Station{{-90, -60, -61, -62, -20}, {}, {}};

    EXPECT_EQ(Value(-61), infoOf(32, facts, "RSSI"));
}

TEST(RadioTests, TakeTheBeaconsStrengthWhereTheLinkTellsNone) {
    Facts facts = joinedTo({heard(kName, 2412, -64)});
    facts.station = Station{{}, 2, 100};

    EXPECT_EQ(Value(-64), infoOf(32, facts, "RSSI"));
}

TEST(RadioTests, TakeTheScansStrengthOfANamedNetwork) {
    Facts facts = askedAbout("Northlight", {heard(kName, 2412, -80)});
    facts.station = Station{{-40}, {}, {}};

    EXPECT_TRUE(resultOf(32, facts));
    EXPECT_EQ(Value(-80), infoOf(32, facts, "RSSI"));
}

TEST(RadioTests, FindASignalPoorTooCloseToTheNoise) {
    Facts facts = joinedTo({heard(kName, 2437, -70)});
    facts.station = Station{{-70}, {}, {}};

    facts.survey = Survey{{2412, false, -60}, {2437, true, -88}};
    EXPECT_FALSE(resultOf(32, facts));
    EXPECT_EQ(Value(-88), infoOf(32, facts, "Noise"));
    facts.survey = Survey{{2437, true, -87}};
    EXPECT_TRUE(resultOf(32, facts));
}

TEST(RadioTests, TakeANoiseThatNoRadioHearsForNone) {
    Facts facts = joinedTo({heard(kName, 2437, -50)});
    for (const int noise : {0, 3, -111}) {
        facts.survey = Survey{{2437, true, noise}};
        EXPECT_FALSE(resultOf(32, facts)) << noise;
        EXPECT_EQ(Value(), infoOf(32, facts, "Noise")) << noise;
    }
    facts.survey = Survey{{2437, false, 0}, {2437, true, -95}};
    EXPECT_EQ(Value(-95), infoOf(32, facts, "Noise"));
}

TEST(RadioTests, NeverInventANoise) {
    Facts facts = joinedTo({heard(kName, 2437, -70)});
    facts.survey = Survey{{2437, true, std::nullopt}};
    EXPECT_EQ(Value(), infoOf(32, facts, "Noise"));
    EXPECT_FALSE(resultOf(32, facts));
    facts.survey = failure(Reason::unsupported, "the driver has no survey");
    EXPECT_FALSE(resultOf(32, facts));
}

TEST(RadioTests, RefuseImpossibleSignals) {
    for (const int signal : {0, 5, -111}) {
        Facts facts = joinedTo({heard(kName, 2412, signal)});
        EXPECT_EQ(10, errorOf(32, facts)) << signal;
    }
    Facts none = joinedTo({heard(kName)});
    none.link->joined->signal.reset();
    EXPECT_EQ(5, errorOf(32, none));
}

TEST(RadioTests, FindMixedModesWithinOneBandAndName) {
    const AccessPoint old = heard(kName, 5180);
    const AccessPoint n = heard(kName + kHt, 5180);
    const AccessPoint ac = heard(kName + kHt + kVht, 5180);
    const AccessPoint n24 = heard(kName + kHt, 2412);
    const AccessPoint other = heard(nameElement("Other"), 5180);

    EXPECT_TRUE(resultOf(36, joinedTo({ac, n})));
    EXPECT_FALSE(resultOf(37, joinedTo({ac, n})));
    EXPECT_TRUE(resultOf(37, joinedTo({n, old})));
    EXPECT_FALSE(resultOf(36, joinedTo({ac, n24, other})));
    EXPECT_FALSE(resultOf(37, joinedTo({ac, n24, other})));
}

TEST(RadioTests, Find11NOfferedInVainWithAnOldCipher) {
    EXPECT_TRUE(resultOf(37, joinedTo({heard(kName + kHt + wpaElement({2}, {2}), 2412, -50, kPrivacy)})));
    EXPECT_TRUE(resultOf(37, joinedTo({heard(kName + kHt, 2412, -50, kPrivacy)})));
    EXPECT_FALSE(resultOf(37, joinedTo({heard(kName + kHt + wpaElement({2}, {2}) + rsnElement(2, {4}, {2}),
                                              2412, -50, kPrivacy)})));
    EXPECT_FALSE(resultOf(37, joinedTo({heard(kName + wpaElement({2}, {2}), 2412, -50, kPrivacy)})));
}

TEST(RadioTests, NameTheModesOldestFirst) {
    const Frame rates = element(1, {0x82, 0x84, 0x8B, 0x96, 0x0C, 0x12});
    const Frame ofdm = element(1, {0x8C, 0x12, 0x98});
    const Frame he = element(255, {35, 0});
    const Frame eht = element(255, {108, 0});

    EXPECT_EQ("b/g/n", phyModesOf(heard(kName + rates + kHt + kVht)));
    EXPECT_EQ("b", phyModesOf(heard(element(1, {0x82, 0x84}))));
    EXPECT_EQ("g/n/ax", phyModesOf(heard(ofdm + kHt + he)));
    EXPECT_EQ("a/n/ac", phyModesOf(heard(ofdm + kHt + kVht, 5180)));
    EXPECT_EQ("ax/be", phyModesOf(heard(ofdm + he + eht, 5955)));
    EXPECT_EQ(Value("a/n/ac"), infoOf(36, joinedTo({heard(ofdm + kHt + kVht, 5180)}), "SupportedPHYModes"));
}

TEST(RadioTests, FindRatesLegacyUpTo11MbitOrWithOlderStations) {
    const Frame b = element(1, {0x82, 0x84, 0x8B, 0x96});
    const Frame g = b + element(50, {0x0C, 0x12, 0x18, 0x24});

    EXPECT_TRUE(resultOf(41, joinedTo({heard(b)})));
    EXPECT_FALSE(resultOf(41, joinedTo({heard(g + element(42, {4}))})));
    EXPECT_TRUE(resultOf(41, joinedTo({heard(g + element(42, {1}))})));
    EXPECT_TRUE(resultOf(41, joinedTo({heard(g + element(42, {2}))})));
    EXPECT_FALSE(resultOf(41, joinedTo({heard(b, 5180)})));
    EXPECT_EQ(10, errorOf(41, joinedTo({heard(kName)})));
}

TEST(RadioTests, DoNotTakeAMembershipSelectorForARate) {
    EXPECT_TRUE(resultOf(41, joinedTo({heard(element(1, {0x82, 0x96, 0xFF, 0xFE, 0xFB}))})));
}

TEST(RadioTests, MapFrequenciesToBandsAndChannels) {
    EXPECT_EQ(1, channelOf(2412));
    EXPECT_EQ(14, channelOf(2484));
    EXPECT_EQ(36, channelOf(5180));
    EXPECT_EQ(177, channelOf(5885));
    EXPECT_EQ(2, channelOf(5935));
    EXPECT_EQ(5, channelOf(5975));
    EXPECT_EQ(0, channelOf(902));
    EXPECT_EQ(Band::ghz6, bandOf(5955));
    EXPECT_EQ(Band::ghz5, bandOf(5825));
}

}  // namespace
}  // namespace wp
