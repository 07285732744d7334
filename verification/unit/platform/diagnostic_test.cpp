#include "platform/diagnostic.h"

#include <gtest/gtest.h>

namespace wp {
namespace {

TEST(DiagnosticResult, HoldsNothingBeforeItIsSealed) {
    DiagnosticResult result;

    EXPECT_FALSE(result.statusCode().has_value());
    EXPECT_EQ(result.data(), nullptr);
}

TEST(DiagnosticResult, KeepsTheFirstCodeAndDataTogether) {
    DiagnosticResult result;
    DictionaryPointer first = Dictionary::make();

    EXPECT_TRUE(result.seal(-5, first));
    EXPECT_FALSE(result.seal(0, Dictionary::make()));

    EXPECT_EQ(result.statusCode(), -5);
    EXPECT_EQ(result.data(), first);
}

}  // namespace
}  // namespace wp
