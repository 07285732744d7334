#include "platform/parameter_reader.h"

#include <gtest/gtest.h>

namespace wp {
namespace {

ParameterReader readerOf(Dictionary::Entries entries) {
    return ParameterReader(Dictionary::make(std::move(entries)));
}

TEST(ParameterReader, AcceptsBothBoundsOfANumber) {
    ParameterReader reader = readerOf({{"low", 0}, {"high", 600u}, {"between", 0.5}});

    EXPECT_EQ(reader.requiredNumber("low", 0, 600), Value(0));
    EXPECT_EQ(reader.requiredNumber("high", 0, 600), Value(600u));
    EXPECT_EQ(reader.requiredNumber("between", 0, 600), Value(0.5));
    EXPECT_FALSE(reader.failed());
}

TEST(ParameterReader, RefusesNumbersOutsideTheBoundsAndThingsThatAreNoNumbers) {
    for (Value value : {Value(-1), Value(601), Value(600.5), Value(true), Value("60"), Value(NullMarker{})}) {
        ParameterReader reader = readerOf({{"key", value}});

        EXPECT_FALSE(reader.requiredNumber("key", 0, 600).has_value());
        EXPECT_TRUE(reader.failed());
    }
}

TEST(ParameterReader, RefusesAMissingNumberWithItsName) {
    ParameterReader reader = readerOf({});

    EXPECT_FALSE(reader.requiredNumber("age", 0, 600).has_value());
    EXPECT_EQ(reader.reason(), "\"age\" is missing: it must be a number from 0 to 600");
}

TEST(ParameterReader, TakesOnlyGenuineBooleans) {
    EXPECT_TRUE(readerOf({{"key", true}}).requiredBool("key"));
    for (Value value : {Value(1), Value("true"), Value(NullMarker{})}) {
        ParameterReader reader = readerOf({{"key", value}});

        EXPECT_FALSE(reader.requiredBool("key"));
        EXPECT_TRUE(reader.failed());
    }
}

TEST(ParameterReader, CountsTheLengthOfAStringInCharactersNotBytes) {
    std::string accents;
    for (int i = 0; i < 32; ++i) accents += "\xC3\xA9";

    EXPECT_EQ(readerOf({{"key", accents}}).optionalString("key", 32, std::nullopt), accents);

    ParameterReader tooLong = readerOf({{"key", accents + "x"}});
    EXPECT_FALSE(tooLong.optionalString("key", 32, std::nullopt).has_value());
    EXPECT_EQ(tooLong.reason(), "\"key\" has 33 characters: 32 are allowed");
}

TEST(ParameterReader, GivesTheDefaultForAMissingStringWithoutFailing) {
    ParameterReader reader = readerOf({});

    EXPECT_EQ(reader.optionalString("key", 32, "default"), "default");
    EXPECT_FALSE(reader.failed());
}

TEST(ParameterReader, KeepsTheFirstReasonAndStillReadsTheRest) {
    ParameterReader reader = readerOf({{"flag", 1}, {"name", "Home"}});

    reader.requiredBool("flag");

    EXPECT_EQ(reader.optionalString("name", 32, std::nullopt), "Home");
    EXPECT_EQ(reader.reason(), "\"flag\" is a number: it must be true or false");
}

}  // namespace
}  // namespace wp
