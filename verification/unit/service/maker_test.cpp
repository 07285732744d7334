#include "service/maker.h"

#include <gtest/gtest.h>

#include "service/plain_text.h"
#include "verification/unit/service/finding.h"
#include "verification/unit/service/frames.h"
#include "verification/unit/service/verdict.h"

namespace wp {
namespace {

Frame attribute(unsigned type, std::string_view text) {
    return Frame{static_cast<std::uint8_t>(type >> 8), static_cast<std::uint8_t>(type),
                 static_cast<std::uint8_t>(text.size() >> 8), static_cast<std::uint8_t>(text.size())} +
           Frame(text.begin(), text.end());
}

constexpr std::uint32_t kWps = 0x0050F204;
const Known<RouterDescription> kSilent = failure(Reason::timeout, "no answer");
const Vendors::BaseStation kExample{{"Example Networks"}, {{0x02, 0x11, 0x22}}};

TEST(WpsDescription, IsReadFromAttributesSpreadOverElements) {
    const Frame all = attribute(0x104A, "\x10") + attribute(0x1021, "Example Networks GmbH") +
                      attribute(0x1023, " Base 5 ") + attribute(0x1024, "v2") + attribute(0x1011, "Attic");
    const Frame first(all.begin(), all.begin() + 20), second(all.begin() + 20, all.end());

    const WpsDescription read = decodeWps(vendorElement(kWps, first) + vendorElement(kWps, second));

    EXPECT_EQ(read.manufacturer, "Example Networks GmbH");
    EXPECT_EQ(read.modelName, "Base 5");
    EXPECT_EQ(read.modelNumber, "v2");
    EXPECT_EQ(read.deviceName, "Attic");
}

TEST(WpsDescription, AnAttributeThatReachesBeyondTheEndEndsIt) {
    Frame cut = attribute(0x1021, "Example") + attribute(0x1023, "Model");
    cut.resize(cut.size() - 2);
    const WpsDescription read = decodeWps(vendorElement(kWps, cut));
    EXPECT_EQ(read.manufacturer, "Example");
    EXPECT_EQ(read.modelName, "");
    EXPECT_EQ(decodeWps(vendorElement(kWps, {0x10})).manufacturer, "");
    EXPECT_EQ(decodeWps({}).manufacturer, "");
}

TEST(PlainText, KeepsUtf8EscapesOtherBytesAndDropsControls) {
    EXPECT_EQ(plainText("  B\xC3\xBCro \xE2\x82\xAC "), "B\xC3\xBCro \xE2\x82\xAC");
    EXPECT_EQ(plainText("a\xFFz\xC3"), "a\\xFFz\\xC3");
    EXPECT_EQ(plainText("a\x1B[2Jz\n\x7F\xC2\x9B"), "a[2Jz");
    EXPECT_EQ(plainText("\xED\xA0\x80"), "\\xED\\xA0\\x80");
    EXPECT_EQ(plainText("\xC0\xAF"), "\\xC0\\xAF");
    EXPECT_EQ(plainText("abcdef", 3), "abc");
    EXPECT_EQ(plainText("   "), "");
}

TEST(VendorBaseStation, IsKnownByItsMakersNameWithoutCase) {
    const AccessPoint ours =
        heard(vendorElement(kWps, attribute(0x1021, "EXAMPLE networks") + attribute(0x1023, "Base 5")));
    const AccessPoint other = heard(vendorElement(kWps, attribute(0x1021, "Sample Networks")));

    const Outcome outcome = isVendorBaseStation(ours, kSilent, kExample);

    EXPECT_TRUE(found(outcome));
    EXPECT_TRUE(outcome->didPass);
    EXPECT_EQ(informationOf(outcome, "MarlixModelName"), Value("Base 5"));
    EXPECT_FALSE(found(isVendorBaseStation(other, kSilent, kExample)));
}

TEST(VendorBaseStation, IsKnownByItsAddressAndTakesTheRoutersModel) {
    AccessPoint ours = heard(nameElement("Home"));
    ours.address = {0x02, 0x11, 0x22, 0x33, 0x44, 0x55};
    const RouterDescription router{"Someone", "Router 7", "Attic"};
    EXPECT_EQ(informationOf(isVendorBaseStation(ours, router, kExample), "MarlixModelName"),
              Value("Router 7"));
    EXPECT_EQ(isVendorBaseStation(ours, kSilent, kExample)->info, nullptr);
}

TEST(VendorBaseStation, IsKnownByWhatTheRouterSays) {
    const AccessPoint plain = heard(nameElement("Home"));
    EXPECT_TRUE(found(isVendorBaseStation(plain, RouterDescription{"Example Networks", "", ""}, kExample)));
    EXPECT_FALSE(found(isVendorBaseStation(plain, RouterDescription{"Someone", "", ""}, kExample)));
}

TEST(VendorBaseStation, OfWhichNobodySaysWhoMadeItCannotBeTold) {
    const AccessPoint plain = heard(nameElement("Home"));
    EXPECT_TRUE(cannotTell(isVendorBaseStation(plain, kSilent, kExample), Reason::timeout));
    EXPECT_TRUE(
        cannotTell(isVendorBaseStation(plain, RouterDescription{"", "", ""}, kExample), Reason::unsupported));
    // Where addresses alone decide, each tells.
    EXPECT_FALSE(found(isVendorBaseStation(plain, kSilent, {{}, {{0x02, 0x11, 0x22}}})));
    EXPECT_TRUE(cannotTell(isVendorBaseStation(plain, kSilent, {}), Reason::badConfiguration));
}

TEST(VendorHotspot, IsKnownByAnElementAnAddressOrALease) {
    const Vendors::Hotspot byElement{{{{0xAA, 0xBB, 0xCC}, std::uint8_t{9}}}, {}, {}};
    EXPECT_TRUE(found(isVendorHotspot(heard(vendorElement(0xAABBCC09)), std::string(), byElement)));
    EXPECT_FALSE(found(isVendorHotspot(heard(vendorElement(0xAABBCC08)), std::string(), byElement)));
    EXPECT_FALSE(found(isVendorHotspot(heard(element(221, {0xAA, 0xBB, 0xCC})), std::string(), byElement)));

    AccessPoint phone = heard(nameElement("Phone"));
    phone.address = {0x02, 0x1A, 0x11, 0xF0, 0x01, 0x02};
    EXPECT_TRUE(found(isVendorHotspot(phone, std::string(), {{}, {{0x02, 0x1A, 0x11}}, {}})));
    EXPECT_FALSE(found(isVendorHotspot(phone, std::string(), {{}, {{0x02, 0x1A, 0x12}, {}}, {}})));

    EXPECT_TRUE(
        found(isVendorHotspot(phone, std::string("x EXAMPLE_METERED"), {{}, {}, {"EXAMPLE_METERED"}})));
    EXPECT_FALSE(found(isVendorHotspot(phone, std::string(), {{}, {}, {"EXAMPLE_METERED", ""}})));
}

TEST(VendorHotspot, IsKnownByAnElementInEitherFrame) {
    const Vendors::Hotspot byElement{{{{0xAA, 0xBB, 0xCC}, std::uint8_t{9}}}, {}, {}};
    AccessPoint phone = heard(vendorElement(0xAABBCC09));
    phone.elements = nameElement("Phone");
    EXPECT_TRUE(found(isVendorHotspot(phone, std::string(), byElement)));
    std::swap(phone.elements, *phone.beaconElements);
    EXPECT_TRUE(found(isVendorHotspot(phone, std::string(), byElement)));
}

TEST(VendorBaseStation, IsNamedByTheAnswerWhoseBeaconOnlySaysThatItHasWps) {
    AccessPoint ours = heard(vendorElement(kWps, attribute(0x1044, "\x02")));
    ours.elements = vendorElement(kWps, attribute(0x1021, "Example Networks") + attribute(0x1023, "Base 5"));
    EXPECT_EQ(informationOf(isVendorBaseStation(ours, kSilent, kExample), "MarlixModelName"),
              Value("Base 5"));
}

TEST(VendorHotspot, WithoutALeaseCannotBeToldWhereOnlyALeaseCould) {
    AccessPoint phone = heard(nameElement("Phone"));
    phone.address = {0x02, 0x1A, 0x11, 0xF0, 0x01, 0x02};
    const Known<std::string> none = failure(Reason::unavailable, "no lease");

    EXPECT_TRUE(cannotTell(isVendorHotspot(phone, none, {{}, {}, {"EXAMPLE_METERED"}}), Reason::unavailable));
    EXPECT_TRUE(found(isVendorHotspot(phone, none, {{}, {{0x02, 0x1A}}, {"EXAMPLE_METERED"}})));
    EXPECT_FALSE(found(isVendorHotspot(phone, none, {{}, {{0x02, 0x1B}}, {}})));
    EXPECT_TRUE(cannotTell(isVendorHotspot(phone, none, {}), Reason::badConfiguration));
}

TEST(VendorBaseStation, TheReasonSaysWhoWasSilent) {
    const auto reason = [](int number, const Facts& facts) {
        const Outcome outcome = verdictOf(number, facts);
        return outcome ? "" : outcome.error().text();
    };
    Facts joined = joinedTo({heard(nameElement("Home"))});
    joined.settings.vendors.baseStation = kExample;
    joined.router = failure(Reason::timeout, "the router's description took too long");
    Facts named = askedAbout("Home", {heard(nameElement("Home"))});
    named.settings.vendors.baseStation = kExample;
    named.settings.vendors.hotspot.leaseTexts = {"EXAMPLE_METERED"};

    EXPECT_EQ(reason(33, joined),
              "the access point does not say who made it, and nor does its router: the router's description "
              "took too long (code 7)");
    EXPECT_EQ(reason(33, named), "the access point does not say who made it (code 5)");
    EXPECT_EQ(reason(44, named),
              "some hotspots show in their lease alone, and of a named network there is none (code 5)");
    joined.router = failure(Reason::cancelled, "cancelled");
    EXPECT_EQ(reason(33, joined), "cancelled (code 8)");
}

}  // namespace
}  // namespace wp
