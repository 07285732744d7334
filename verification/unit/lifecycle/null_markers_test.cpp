#include "lifecycle/null_markers.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "verification/unit/fakes/printing.h"

namespace wp {
namespace {

TEST(NullMarkers, KeepAStringAlsoAnEmptyOne) {
    EXPECT_EQ(stringOrNull("Home"), Value("Home"));
    EXPECT_EQ(stringOrNull(""), Value(""));
    EXPECT_EQ(stringOrNull(std::nullopt), Value(NullMarker()));
}

TEST(NullMarkers, KeepANumberOfAnyKind) {
    for (const Value& number : {Value(-1), Value(7u), Value(0.5), Value(true)})
        EXPECT_EQ(numberOrNull(number), number);
    EXPECT_EQ(numberOrNull(std::nullopt), Value(NullMarker()));
}

TEST(NullMarkers, KeepTheVeryDictionary) {
    DictionaryPointer dictionary = Dictionary::make();

    EXPECT_EQ(*dictionaryOrNull(dictionary).as<DictionaryPointer>(), dictionary);
    EXPECT_EQ(dictionaryOrNull(nullptr), Value(NullMarker()));
}

TEST(NullMarkers, StandForNoDoubleButNaN) {
    constexpr double kInfinity = std::numeric_limits<double>::infinity();

    EXPECT_EQ(numberOrNullForDouble(std::nan("")), Value(NullMarker()));
    EXPECT_EQ(numberOrNullForDouble(0.0), Value(0.0));
    EXPECT_EQ(numberOrNullForDouble(kInfinity), Value(kInfinity));
    EXPECT_EQ(numberOrNullForDouble(-kInfinity), Value(-kInfinity));
}

TEST(NullMarkers, AreRemovedFromADictionaryWithAllTheirEntries) {
    DictionaryPointer dictionary = Dictionary::make({{"a", NullMarker()},
                                                     {"b", 1},
                                                     {"c", ""},
                                                     {"d", NullMarker()},
                                                     {"e", false},
                                                     {"f", DictionaryPointer()},
                                                     {"g", ArrayPointer()}});

    removeNullFromDictionary(dictionary);

    EXPECT_EQ(dictionary->entries(), (Dictionary::Entries{{"b", 1}, {"c", ""}, {"e", false}}));
}

TEST(NullMarkers, StayInNestedDictionariesAndArrays) {
    DictionaryPointer nested = Dictionary::make({{"a", NullMarker()}});
    DictionaryPointer dictionary = Dictionary::make({{"nested", nested}, {"array", Array{NullMarker()}}});
    Dictionary::Entries before = dictionary->entries();

    removeNullFromDictionary(dictionary);

    EXPECT_EQ(dictionary->entries(), before);
    EXPECT_EQ(nested->size(), 1U);
}

TEST(NullMarkers, MayBeLookedForInNoDictionary) {
    removeNullFromDictionary(nullptr);
}

}  // namespace
}  // namespace wp
