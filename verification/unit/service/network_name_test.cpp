#include "service/network_name.h"

#include <gtest/gtest.h>

#include <random>

#include "verification/unit/service/frames.h"

namespace wp {
namespace {

NetworkName nameOfBytes(const Frame& bytes) {
    return NetworkName(Bytes(bytes));
}

NetworkName nameOfText(std::string_view bytes) {
    return nameOfBytes(Frame(bytes.begin(), bytes.end()));
}

TEST(NetworkName, StandsAsItIsWhenItIsValidUtf8) {
    for (const std::string_view text :
         {"Home", "Café", "日本語", "\U0001F4FA", "a b", " ", "100%n", "\x1B]0;x\x07"}) {
        EXPECT_EQ(text, textFromName(nameOfText(text)));
    }
}

TEST(NetworkName, HasEachByteThatIsNoUtf8Escaped) {
    EXPECT_EQ("caf\\xE9", textFromName(nameOfText("caf\xE9")));
    EXPECT_EQ("\\xFF\\xFEé", textFromName(nameOfText("\xFF\xFE\xC3\xA9")));
}

TEST(NetworkName, TakesOverlongFormsSurrogatesAndTooLargeNumbersForInvalid) {
    EXPECT_EQ("\\xC0\\x80", textFromName(nameOfText("\xC0\x80")));
    EXPECT_EQ("\\xED\\xA0\\x80", textFromName(nameOfText("\xED\xA0\x80")));
    EXPECT_EQ("\\xF4\\x90\\x80\\x80", textFromName(nameOfText("\xF4\x90\x80\x80")));
    EXPECT_EQ("\\xE2\\x82", textFromName(nameOfText("\xE2\x82")));
}

TEST(NetworkName, ThatLooksLikeAnEscapeIsEscapedItself) {
    const NetworkName looksEscaped = nameOfText("a\\xFF");

    EXPECT_EQ("a\\x5CxFF", textFromName(looksEscaped));
    EXPECT_EQ(looksEscaped, nameFromText(textFromName(looksEscaped)));
    EXPECT_NE(textFromName(looksEscaped), textFromName(nameOfText("a\xFF")));
}

TEST(NetworkName, KeepsABackslashThatStartsNoEscape) {
    for (const std::string_view text : {"\\", "\\x", "\\xA", "\\xff", "C:\\xray"}) {
        EXPECT_EQ(text, textFromName(nameOfText(text)));
    }
}

TEST(NetworkName, ComesBackFromItsTextWhateverItsBytes) {
    std::mt19937 random(1);
    static constexpr std::string_view kAlphabet = "\\xFE5C0a\xC3\xA9\xFF\x80\xE2";
    for (int round = 0; round < 20000; ++round) {
        Frame bytes(random() % (NetworkName::kMaximumSize + 1));
        for (std::uint8_t& byte : bytes) {
            byte =
                static_cast<std::uint8_t>(round % 2 != 0 ? random() : kAlphabet[random() % kAlphabet.size()]);
        }
        const NetworkName name = nameOfBytes(bytes);
        ASSERT_EQ(name, nameFromText(textFromName(name))) << textFromName(name);
    }
}

TEST(NetworkName, OfMoreThan32BytesIsNone) {
    EXPECT_TRUE(nameFromText(std::string(32, 'a')));
    EXPECT_FALSE(nameFromText(std::string(33, 'a')));
    EXPECT_TRUE(nameFromText("\\xFF" + std::string(31, 'a')));
}

TEST(NetworkName, OfNoBytesOrOfZerosIsAbsent) {
    EXPECT_TRUE(NetworkName().absent());
    EXPECT_TRUE(nameOfBytes(Frame(32, 0)).absent());
    EXPECT_FALSE(nameOfText(" ").absent());
    EXPECT_FALSE(nameOfBytes({0, 1}).absent());
}

TEST(NetworkName, OptsOutOfTestsByItsEndingInAnyCase) {
    EXPECT_TRUE(optsOutOfTests(nameOfText("Cafe_NoMap")));
    EXPECT_TRUE(optsOutOfTests(nameOfText("_nomap")));
    EXPECT_FALSE(optsOutOfTests(nameOfText("nomap")));
    EXPECT_FALSE(optsOutOfTests(nameOfText("Cafe_nomap ")));
}

}  // namespace
}  // namespace wp
