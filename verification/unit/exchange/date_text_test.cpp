#include "exchange/date_text.h"

#include <gtest/gtest.h>

#include "platform/date_formatter.h"

namespace wp {
namespace {

double seconds(std::string_view text) {
    std::optional<Date> date = readISO8601(text);
    if (!date) ADD_FAILURE() << text << " is refused";
    return date ? date->secondsSinceReference : 0;
}

TEST(DateText, ReadsUTC) {
    EXPECT_EQ(seconds("2001-01-01T00:00:00Z"), 0);
    EXPECT_EQ(seconds("2001-01-02T00:00:01Z"), 86401);
    EXPECT_EQ(seconds("2000-02-29T23:59:59Z"), -307 * 86400.0 + 86399);
}

TEST(DateText, ReadsOffsetsInTheirThreeForms) {
    EXPECT_EQ(seconds("2001-01-01T02:30:00+02:30"), 0);
    EXPECT_EQ(seconds("2001-01-01T02:30:00+0230"), 0);
    EXPECT_EQ(seconds("2000-12-31T17:00:00-07"), 0);
}

TEST(DateText, ReadsFractions) {
    EXPECT_EQ(seconds("2001-01-01T00:00:01.25Z"), 1.25);
    EXPECT_EQ(seconds("2001-01-01T00:00:01,5+00:00"), 1.5);
    EXPECT_EQ(seconds("2000-12-31T23:59:59.75Z"), -0.25);
}

TEST(DateText, KeepsTheSecondOfAFractionFinerThanADouble) {
    for (std::string second :
         {"2026-05-01T12:34:56", "2001-01-01T00:00:00", "2000-12-31T23:59:59", "1600-02-29T00:00:00"})
        for (std::string fraction : {".999999999", ".99999999999999999999"})
            EXPECT_EQ(iso8601Text(Date{seconds(second + fraction + "Z")}), second + "Z") << fraction;
}

TEST(DateText, RefusesEveryOtherForm) {
    for (const char* text : {"",
                             "2001-01-01",
                             "2001-01-01T00:00:00",
                             "2001-01-01 00:00:00Z",
                             "2001-01-01T00:00Z",
                             "2001-1-01T00:00:00Z",
                             "2001-13-01T00:00:00Z",
                             "2001-02-29T00:00:00Z",
                             "2001-01-01T24:00:00Z",
                             "2001-01-01T00:60:00Z",
                             "2001-01-01T00:00:60Z",
                             "2001-01-01T00:00:00.Z",
                             "2001-01-01T00:00:00+24",
                             "2001-01-01T00:00:00+2",
                             "2001-01-01T00:00:00+02:",
                             "2001-01-01T00:00:00z",
                             "2001-01-01T00:00:00Z ",
                             "-001-01-01T00:00:00Z",
                             "2001-01-01T00:00:00 02:00",
                             "2001-01-01T00:00:00"}) {
        EXPECT_FALSE(readISO8601(text)) << text;
    }
}

TEST(DateText, WritesWhatItReadsBack) {
    for (double moment : {0.0, 1.25, 736'000'000.123456, -0.25, -62'000'000'000.0, 1e-9}) {
        std::string text = exactISO8601Text(Date{moment});
        EXPECT_EQ(seconds(text), moment) << text;
    }
    EXPECT_EQ(exactISO8601Text(Date{1.25}), "2001-01-01T00:00:01.25Z");
    EXPECT_EQ(exactISO8601Text(Date{2}), "2001-01-01T00:00:02Z");
}

}  // namespace
}  // namespace wp
