#pragma once

#include <gtest/gtest.h>

#include "service/outcome.h"

namespace wp {

/// The result of an outcome that can tell; a failure of the calling test where it cannot.
inline bool found(const Outcome& outcome) {
    EXPECT_TRUE(outcome) << (outcome ? "" : outcome.error().text());
    return outcome && outcome->result;
}

inline bool cannotTell(const Outcome& outcome, Reason reason) {
    return !outcome && outcome.error().code == static_cast<int>(reason) && !outcome.error().message.empty();
}

/// A value of the information; a null marker where there is none.
inline Value informationOf(const Outcome& outcome, std::string_view key) {
    if (!outcome || outcome->info == nullptr) return {};
    return outcome->info->value(key).value_or(Value());
}

}  // namespace wp
