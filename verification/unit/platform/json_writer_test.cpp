#include "platform/json_writer.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "platform/records.h"

namespace wp {
namespace {

std::string compact(const Value& value) {
    return jsonText(value, JSONStyle::compact);
}

TEST(JSONWriter, SortsKeysAndIndentsByTwoBlanks) {
    Value document = Dictionary::make(
        {{"statusCode", 0},
         {"data", Dictionary::make({{"device", Dictionary::make()}, {"list", Array{1, Array{}}}})}});
    EXPECT_EQ(jsonText(document, JSONStyle::indented), R"({
  "data": {
    "device": {},
    "list": [
      1,
      []
    ]
  },
  "statusCode": 0
})");
}

TEST(JSONWriter, WritesNoBlanksInTheCompactForm) {
    Value document = Dictionary::make({{"b", Array{true, false}}, {"a", NullMarker{}}});
    EXPECT_EQ(compact(document), R"({"a":null,"b":[true,false]})");
}

TEST(JSONWriter, KeepsTheKindOfEveryNumber) {
    EXPECT_EQ(compact(1), "1");
    EXPECT_EQ(compact(1.0), "1.0");
    EXPECT_EQ(compact(true), "true");
    EXPECT_EQ(compact(-0.0), "-0.0");
    EXPECT_EQ(compact(std::numeric_limits<std::int64_t>::min()), "-9223372036854775808");
    EXPECT_EQ(compact(std::numeric_limits<std::uint64_t>::max()), "18446744073709551615");
}

TEST(JSONWriter, WritesDoublesAsTheShortestDecimalThatReadsBack) {
    EXPECT_EQ(compact(0.1), "0.1");
    EXPECT_EQ(compact(100000.0), "100000.0");
    EXPECT_EQ(compact(0.0001), "0.0001");
    EXPECT_EQ(compact(0.00001), "1e-05");
    EXPECT_EQ(compact(1e16), "1e+16");
    EXPECT_EQ(compact(123456789012345.67), "123456789012345.67");
}

TEST(JSONWriter, WritesWhatJSONCannotExpressAsNull) {
    EXPECT_EQ(compact(std::nan("")), "null");
    EXPECT_EQ(compact(std::numeric_limits<double>::infinity()), "null");
    EXPECT_EQ(compact(-std::numeric_limits<double>::infinity()), "null");
    EXPECT_EQ(compact(std::make_shared<WiFiScanResult>()), "null");
}

TEST(JSONWriter, EscapesControlCharactersAndLineSeparators) {
    EXPECT_EQ(compact(std::string("\0\x1f\n\t\"\\/", 7)), R"("\u0000\u001f\n\t\"\\/")");
    EXPECT_EQ(compact("\x7f\u0080\u009f\u00a0"), "\"\\u007f\\u0080\\u009f\u00a0\"");
    EXPECT_EQ(compact("\u2027\u2028\u2029\u202a"), "\"\u2027\\u2028\\u2029\u202a\"");
}

TEST(JSONWriter, KeepsTextBeyondASCIIAsItStands) {
    EXPECT_EQ(compact("Grüße 東 😀"), "\"Grüße 東 😀\"");
}

TEST(JSONWriter, ReplacesBytesThatAreNoUTF8) {
    EXPECT_EQ(compact("a\xff"), "\"a\uFFFD\"");
    EXPECT_EQ(compact("\xc3"), "\"\uFFFD\"");
    EXPECT_EQ(compact("\xed\xa0\x80"), "\"\uFFFD\uFFFD\uFFFD\"");            // a surrogate
    EXPECT_EQ(compact("\xc0\x80"), "\"\uFFFD\uFFFD\"");                      // an overlong null
    EXPECT_EQ(compact("\xf4\x90\x80\x80"), "\"\uFFFD\uFFFD\uFFFD\uFFFD\"");  // beyond U+10FFFF
}

TEST(JSONWriter, WritesADateAsItsISO8601Text) {
    EXPECT_EQ(compact(Date{0.75}), "\"2001-01-01T00:00:00Z\"");
}

TEST(JSONWriter, WritesASinglePrecisionFractionAsItsOwnShortestDecimal) {
    EXPECT_EQ(compact(shortestDecimal(0.1F)), "0.1");
    EXPECT_EQ(compact(shortestDecimal(1.0F / 3)), "0.33333334");
    EXPECT_EQ(compact(shortestDecimal(1.0F)), "1.0");
}

}  // namespace
}  // namespace wp
