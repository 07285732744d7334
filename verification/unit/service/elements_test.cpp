#include "service/elements.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "verification/unit/service/frames.h"

namespace wp {
namespace {

TEST(Elements, FindsEachKindByItsIdentifier) {
    const Frame frame = nameElement("Home") + element(1, {0x82}) + element(5, {0, 2, 0, 0}) +
                        element(255, {35, 7}) + vendorElement(0x506F9A10, {9});

    const Elements elements = decodeElements(frame);

    EXPECT_FALSE(elements.malformed);
    EXPECT_EQ(4U, elements.name.size);
    EXPECT_EQ(2, elements.trafficMap.data[1]);
    ASSERT_TRUE(elements.heCapabilities.present());
    EXPECT_EQ(7, elements.heCapabilities.data[0]);
    ASSERT_TRUE(elements.hotspot.present());
    EXPECT_EQ(9, elements.hotspot.data[0]);
    EXPECT_FALSE(elements.rsn.present());
}

TEST(Elements, KeepsTheFirstOfTwoOfOneKind) {
    const Frame frame = nameElement("First") + nameElement("Second");

    const Elements elements = decodeElements(frame);

    EXPECT_EQ(NetworkName(elements.name.bytes()), nameFromText("First"));
}

TEST(Elements, StopsAtALengthThatReachesBeyondTheEndAndKeepsWhatCameBefore) {
    const Frame frame = nameElement("Home") + Frame{48, 20, 1, 0};

    const Elements elements = decodeElements(frame);

    EXPECT_TRUE(elements.malformed);
    EXPECT_TRUE(elements.name.present());
    EXPECT_FALSE(elements.rsn.present());
}

TEST(Elements, TakesAnElementThatEndsExactlyAtTheEnd) {
    const Frame frame = element(42, {3});

    const Elements elements = decodeElements(frame);

    EXPECT_FALSE(elements.malformed);
    EXPECT_EQ(3, elements.protection.data[0]);
}

TEST(Elements, CallsALonelyLastByteMalformed) {
    EXPECT_TRUE(decodeElements(nameElement("a") + Frame{1}).malformed);
}

TEST(Elements, TellsAnEmptyElementFromAnAbsentOne) {
    const Frame frame = nameElement("");

    EXPECT_TRUE(decodeElements(frame).name.present());
    EXPECT_FALSE(decodeElements({}).name.present());
}

TEST(Elements, PassesOverVendorAndExtensionElementsTooShortToTellTheirKind) {
    const Frame frame = element(221, {0x00, 0x50, 0xF2}) + element(255, {}) + nameElement("Home");

    const Elements elements = decodeElements(frame);

    EXPECT_FALSE(elements.malformed);
    EXPECT_FALSE(elements.wpa.present());
    EXPECT_TRUE(elements.name.present());
}

TEST(Elements, OfAnAnswerAreCompletedByTheBeacon) {
    const Frame answer = nameElement("Home");
    const Frame beacon = nameElement("") + element(5, {0, 3, 0, 0});
    Elements elements = decodeElements(answer);

    addMissingElements(elements, decodeElements(beacon));

    EXPECT_EQ(4U, elements.name.size);
    EXPECT_EQ(3, elements.trafficMap.data[1]);
}

/// BSS Load of so many 255ths.
Frame loadElement(std::uint8_t utilisation) {
    return element(11, {2, 0, utilisation, 0, 0});
}

TEST(Advertised, OfAFreshBeaconCountsMoreThanThatOfAnOldAnswer) {
    const Frame answer = nameElement("Home") + element(7, {'D', 'E', ' '}) + loadElement(20) +
                         element(61, {6, 0}) + element(107, {0});
    const Frame beacon = nameElement("") + element(5, {0, 3, 0, 0}) + loadElement(200) + element(61, {6, 1});

    const Advertised says = decodeAdvertised(0, answer, Bytes(beacon));

    EXPECT_EQ(200, says.load);
    EXPECT_EQ(1, says.htSecondary);
    EXPECT_EQ(3, says.dtimPeriod);
    EXPECT_EQ(nameFromText("Home"), says.name);
    EXPECT_EQ(true, says.hidesName);
    EXPECT_EQ((CountryCode{'D', 'E'}), says.country);
    EXPECT_TRUE(says.interworking);
}

TEST(Advertised, OfEitherFrameAloneIsWhatItSays) {
    EXPECT_EQ(20, decodeAdvertised(0, loadElement(20), std::nullopt).load);
    EXPECT_EQ(200, decodeAdvertised(0, {}, Bytes(loadElement(200))).load);
}

TEST(Elements, OfANetworkWithinAnothersBeaconTellItsOwnDtimPeriod) {
    const Frame beacon = element(5, {0, 1, 0, 0}) + element(85, {1, 5, 0});

    EXPECT_EQ(5, decodeAdvertised(0, beacon, beacon).dtimPeriod);
    // In answers the element has no period.
    EXPECT_EQ(1,
              decodeAdvertised(0, element(85, {1}), element(5, {0, 1, 0, 0}) + element(85, {1})).dtimPeriod);
}

TEST(Elements, ReadNoByteBeyondAnyPrefixOfAFrame) {
    const Frame frame = nameElement("Home") + rsnElement(4, {4, 2}, {2, 8}) + wpaElement({2}, {2}) +
                        element(7, {'U', 'S', ' '}) + element(255, {35, 1});

    for (std::size_t size = 0; size <= frame.size(); ++size) {
        // An exact copy lets the address sanitizer see a read beyond it.
        const Frame prefix(frame.begin(), frame.begin() + static_cast<std::ptrdiff_t>(size));
        const Advertised says = decodeAdvertised(kPrivacy, prefix, std::nullopt);
        EXPECT_LE(says.name.bytes().size(), 4U);
    }
}

}  // namespace
}  // namespace wp
