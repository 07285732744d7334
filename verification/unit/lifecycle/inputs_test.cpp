#include <gtest/gtest.h>

#include "lifecycle/network_name.h"
#include "lifecycle/wifi_profile_inputs.h"
#include "verification/unit/fakes/printing.h"

namespace wp {
namespace {

class Inputs : public ::testing::Test {
  protected:
    bool validate(Dictionary::Entries entries) {
        return inputs.validateAndInitializeParameters(Dictionary::make(std::move(entries)));
    }

    WiFiProfileInputs inputs;
};

TEST_F(Inputs, KeepTheThreeValuesAndTheParametersThemselves) {
    DictionaryPointer parameters =
        Dictionary::make({{"maxScanCacheAge", 30u}, {"reprofileWithUI", true}, {"networkName", "Office"}});

    EXPECT_TRUE(inputs.validateAndInitializeParameters(parameters));

    EXPECT_EQ(inputs.maxScanCacheAge(), Value(30u));
    EXPECT_TRUE(inputs.reprofileWithNetworksListUI());
    EXPECT_EQ(inputs.selectedNetworkName(), "Office");
    EXPECT_EQ(inputs.parameters(), parameters);
    EXPECT_EQ(inputs.failureReason(), "");
}

TEST_F(Inputs, AcceptBothBoundsOfTheScanCacheAge) {
    EXPECT_TRUE(validate({{"maxScanCacheAge", 0}, {"reprofileWithUI", false}}));
    EXPECT_TRUE(validate({{"maxScanCacheAge", 600}, {"reprofileWithUI", false}}));
}

TEST_F(Inputs, RefuseAScanCacheAgeThatIsMissingOutOfBoundsOrNoNumber) {
    EXPECT_FALSE(validate({{"reprofileWithUI", false}}));
    EXPECT_FALSE(validate({{"maxScanCacheAge", 601}, {"reprofileWithUI", false}}));
    EXPECT_FALSE(validate({{"maxScanCacheAge", -1}, {"reprofileWithUI", false}}));
    EXPECT_FALSE(validate({{"maxScanCacheAge", "30"}, {"reprofileWithUI", false}}));
    EXPECT_FALSE(validate({{"maxScanCacheAge", true}, {"reprofileWithUI", false}}));
}

TEST_F(Inputs, KeepTheNumberAsItCame) {
    validate({{"maxScanCacheAge", 2.5}, {"reprofileWithUI", false}});

    EXPECT_EQ(inputs.maxScanCacheAge(), Value(2.5));
}

TEST_F(Inputs, RefuseAMissingListChoiceAndAllButBooleans) {
    EXPECT_FALSE(validate({{"maxScanCacheAge", 30}}));
    EXPECT_FALSE(validate({{"maxScanCacheAge", 30}, {"reprofileWithUI", 1}}));
    EXPECT_FALSE(validate({{"maxScanCacheAge", 30}, {"reprofileWithUI", "true"}}));
    EXPECT_FALSE(inputs.reprofileWithNetworksListUI());
}

TEST_F(Inputs, LeaveTheSelectedNameAbsentWhenTheRequestNamesNone) {
    EXPECT_TRUE(validate({{"maxScanCacheAge", 30}, {"reprofileWithUI", false}}));

    EXPECT_EQ(inputs.selectedNetworkName(), std::nullopt);
}

TEST_F(Inputs, AllowThirtyTwoCharactersInAName) {
    auto withName = [this](const std::string& name) {
        return validate({{"maxScanCacheAge", 30}, {"reprofileWithUI", false}, {"networkName", name}});
    };
    std::string umlauts;
    for (int i = 0; i < 32; ++i) umlauts += "ü";

    EXPECT_TRUE(withName(std::string(32, 'a')));
    EXPECT_TRUE(withName(umlauts));
    EXPECT_TRUE(withName(""));
    EXPECT_FALSE(withName(std::string(33, 'a')));
    EXPECT_FALSE(withName(umlauts + "ü"));
}

TEST_F(Inputs, RefuseANameThatIsNoString) {
    EXPECT_FALSE(validate({{"maxScanCacheAge", 30}, {"reprofileWithUI", false}, {"networkName", 5}}));
}

TEST_F(Inputs, ReadAndStoreTheLaterKeysAlsoWhenTheFirstOneFails) {
    EXPECT_FALSE(validate({{"maxScanCacheAge", 601}, {"reprofileWithUI", true}, {"networkName", "Office"}}));

    EXPECT_EQ(inputs.maxScanCacheAge(), std::nullopt);
    EXPECT_TRUE(inputs.reprofileWithNetworksListUI());
    EXPECT_EQ(inputs.selectedNetworkName(), "Office");
    EXPECT_EQ(inputs.parameters()->size(), 3U);
}

TEST_F(Inputs, ClearTheFailureBeforeTheyValidateAnew) {
    validate({});

    EXPECT_TRUE(validate({{"maxScanCacheAge", 30}, {"reprofileWithUI", false}}));
    EXPECT_EQ(inputs.failureReason(), "");
}

TEST_F(Inputs, SayWhichKeyFailedFirst) {
    validate({{"maxScanCacheAge", 601}, {"networkName", 5}});

    EXPECT_EQ(inputs.failureReason(),
              "\"maxScanCacheAge\" is out of bounds: it must be a number from 0 to 600");
}

TEST_F(Inputs, FillInASelectedNameOnlyWhereThereIsNone) {
    EXPECT_FALSE(inputs.setSelectedNetworkNameIfAbsent(std::nullopt));
    EXPECT_TRUE(inputs.setSelectedNetworkNameIfAbsent("Home"));
    EXPECT_FALSE(inputs.setSelectedNetworkNameIfAbsent("Office"));

    EXPECT_EQ(inputs.selectedNetworkName(), "Home");
}

TEST(NetworkName, IsTheKeyUnderWhichARequestNamesANetwork) {
    EXPECT_STREQ(kNetworkName, "networkName");
}

TEST(NetworkName, AsksNotToBeMeasuredByItsEndInAnyLetterCase) {
    for (const char* name : {"_nomap", "Home_nomap", "Cafe_NoMap", "CAFE_NOMAP", "Caf\xC3\xA9_nomap"})
        EXPECT_TRUE(isNoMapName(name)) << name;
}

TEST(NetworkName, MayHoldTheWordAnywhereElse) {
    for (const char* name : {"", "nomap", "_noma", "_nomap2", "_nomap ", "_nomap_Home", "Home-nomap"})
        EXPECT_FALSE(isNoMapName(name)) << name;
    EXPECT_FALSE(isNoMapName(std::nullopt));
}

}  // namespace
}  // namespace wp
