#pragma once

#include <gtest/gtest.h>

#include "service/catalogue.h"

namespace wp {

inline Outcome verdictOf(int number, const Facts& facts) {
    return judge(*findTest(number), facts);
}

/// The result of a test that can tell; a failure of the calling test where it cannot.
inline bool resultOf(int number, const Facts& facts) {
    const Outcome outcome = verdictOf(number, facts);
    EXPECT_TRUE(outcome) << number << ": " << (outcome ? "" : outcome.error().text());
    return outcome && outcome->result;
}

/// The error code of a test that cannot tell, 0 where it can.
inline int errorOf(int number, const Facts& facts) {
    const Outcome outcome = verdictOf(number, facts);
    return outcome ? 0 : outcome.error().code;
}

/// The value of a key of the test's information; a null marker where there is none.
inline Value infoOf(int number, const Facts& facts, std::string_view key) {
    const Outcome outcome = verdictOf(number, facts);
    if (!outcome || outcome->info == nullptr) return {};
    return outcome->info->value(key).value_or(Value());
}

}  // namespace wp
