#include "platform/date_formatter.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace wp {
namespace {

TEST(Iso8601Text, CountsFromTheFirstSecondOf2001) {
    EXPECT_EQ(iso8601Text({0}), "2001-01-01T00:00:00Z");
}

TEST(Iso8601Text, CutsFractionsTowardsThePast) {
    EXPECT_EQ(iso8601Text({59.999}), "2001-01-01T00:00:59Z");
    EXPECT_EQ(iso8601Text({-0.001}), "2000-12-31T23:59:59Z");
}

TEST(Iso8601Text, KnowsLeapYears) {
    EXPECT_EQ(iso8601Text({730857600}), "2024-02-29T00:00:00Z");
}

TEST(Iso8601Text, HoldsWhatTheFormCannotExpressAtItsEnds) {
    EXPECT_EQ(iso8601Text({std::numeric_limits<double>::infinity()}), "9999-12-31T23:59:59Z");
    EXPECT_EQ(iso8601Text({-1e300}), "0000-01-01T00:00:00Z");
    EXPECT_EQ(iso8601Text({std::nan("")}), "2001-01-01T00:00:00Z");
}

}  // namespace
}  // namespace wp
