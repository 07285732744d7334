#include "service/saved_networks.h"

#include <gtest/gtest.h>

#include "verification/unit/service/finding.h"

namespace wp {
namespace {

SavedNetwork saved(std::string_view name, SavedSecurity security) {
    SavedNetwork network;
    network.name = nameFromText(name).value();
    network.security = security;
    return network;
}

SavedNetworks list(std::vector<SavedNetwork> networks) {
    return {"store", std::move(networks)};
}

TEST(SavedNetworks, MoreThanFiftyAreMany) {
    SavedNetworks fifty = list(std::vector<SavedNetwork>(50, saved("Home", SavedSecurity::sae)));
    const Outcome enough = remembersManyNetworks(fifty);
    fifty.networks.push_back(saved("One more", SavedSecurity::open));
    const Outcome many = remembersManyNetworks(fifty);

    EXPECT_FALSE(found(enough));
    EXPECT_EQ(informationOf(enough, "PNLCount"), Value(std::uint64_t{50}));
    EXPECT_TRUE(found(many));
    EXPECT_EQ(informationOf(many, "PNLCount"), Value(std::uint64_t{51}));
    EXPECT_TRUE(cannotTell(remembersManyNetworks(failure(Reason::notPermitted, "no")), Reason::notPermitted));
}

TEST(SavedNetworks, OneHiddenNetworkSuffices) {
    SavedNetworks networks = list({saved("Home", SavedSecurity::sae), saved("Cellar", SavedSecurity::sae)});
    EXPECT_FALSE(found(remembersHiddenNetworks(networks)));
    networks.networks[1].hidden = true;
    EXPECT_TRUE(found(remembersHiddenNetworks(networks)));
}

TEST(SavedNetworks, TheSameNameOpenAndSecuredConflicts) {
    const auto conflict = [](SavedSecurity one, SavedSecurity other) {
        return found(remembersConflictingSecurity(list({saved("Cafe", one), saved("Cafe", other)})));
    };
    EXPECT_TRUE(conflict(SavedSecurity::open, SavedSecurity::wpa2Personal));
    EXPECT_TRUE(conflict(SavedSecurity::enterprise, SavedSecurity::sae));
    EXPECT_TRUE(conflict(SavedSecurity::open, SavedSecurity::owe));
    EXPECT_FALSE(conflict(SavedSecurity::sae, SavedSecurity::wpa2Personal));
    EXPECT_FALSE(conflict(SavedSecurity::wpaPersonal, SavedSecurity::wpa2Personal));
    EXPECT_FALSE(conflict(SavedSecurity::unknown, SavedSecurity::open));
}

TEST(SavedNetworks, DisabledEntriesAndOtherNamesDoNotConflict) {
    SavedNetworks networks = list({saved("Cafe", SavedSecurity::open), saved("Cafe", SavedSecurity::sae)});
    networks.networks[0].enabled = false;
    EXPECT_FALSE(found(remembersConflictingSecurity(networks)));
    EXPECT_FALSE(found(remembersConflictingSecurity(
        list({saved("Cafe", SavedSecurity::open), saved("cafe", SavedSecurity::sae)}))));
}

TEST(SavedNetworks, TheRecordIsOfTheEntryThatIsInUse) {
    SavedNetworks networks = list({saved("Cafe", SavedSecurity::open), saved("Cafe", SavedSecurity::sae),
                                   saved("Cafe", SavedSecurity::owe)});
    networks.networks[0].enabled = false;
    networks.networks[0].lastJoined = Date{900};
    networks.networks[1].lastJoined = Date{700};
    networks.networks[2].lastJoined = Date{600};

    const SavedNetwork* entry = findSaved(networks, nameFromText("Cafe").value());
    ASSERT_NE(entry, nullptr);
    const auto record = recordOf(*entry, true);

    EXPECT_EQ(record->ssid, "Cafe");
    EXPECT_EQ(record->security, 5);
    EXPECT_TRUE(record->enabled);
    EXPECT_TRUE(record->multiAP);
    EXPECT_EQ(record->lastJoined, Date{700});
    EXPECT_EQ(findSaved(networks, nameFromText("Other").value()), nullptr);
}

}  // namespace
}  // namespace wp
