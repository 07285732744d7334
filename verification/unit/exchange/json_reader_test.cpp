#include "exchange/json_reader.h"

#include <gtest/gtest.h>

#include <clocale>
#include <limits>

namespace wp {
namespace {

Value accepted(std::string_view text) {
    auto outcome = readJSON(text);
    if (auto* refusal = std::get_if<Refusal>(&outcome)) {
        ADD_FAILURE() << refusal->text();
        return {};
    }
    return std::get<Value>(outcome);
}

std::string refusal(std::string_view text, const JSONLimits& limits = {}) {
    auto outcome = readJSON(text, limits);
    auto* refused = std::get_if<Refusal>(&outcome);
    return refused ? refused->text() : "accepted";
}

TEST(JSONReader, ReadsEveryKindOfValue) {
    Value value = accepted(R"({"a": [null, true, -1, 1.0, "x", {}], "b": 18446744073709551615})");

    Value wanted = Dictionary::make({{"a", Array{NullMarker{}, true, -1, 1.0, "x", Dictionary::make()}},
                                     {"b", std::numeric_limits<std::uint64_t>::max()}});
    EXPECT_EQ(value, wanted);
}

TEST(JSONReader, KeepsIntegersSignedWhereTheyFit) {
    EXPECT_EQ(accepted("9223372036854775807"), Value(std::numeric_limits<std::int64_t>::max()));
    EXPECT_EQ(accepted("-9223372036854775808"), Value(std::numeric_limits<std::int64_t>::min()));
    EXPECT_EQ(accepted("9223372036854775808"), Value(std::uint64_t{9223372036854775808U}));
}

TEST(JSONReader, RefusesAnIntegerBeyond64BitsWithItsPath) {
    EXPECT_EQ(refusal(R"({"a": [1, {"b": 18446744073709551616}]})"), "a[1].b: an integer beyond 64 bits");
    EXPECT_EQ(refusal("-9223372036854775809"), "an integer beyond 64 bits");
    EXPECT_EQ(accepted("18446744073709551616.0"), Value(18446744073709551616.0));
}

TEST(JSONReader, ReadsFractionsWhateverTheLocale) {
    const char* set = std::setlocale(LC_NUMERIC, "de_DE.UTF-8");
    Value value = accepted("[1.5, 2e3]");
    std::setlocale(LC_NUMERIC, "C");
    EXPECT_EQ(value, Value(Array{1.5, 2000.0})) << (set ? set : "no such locale here");
}

TEST(JSONReader, RefusesANumberBeyondADouble) {
    EXPECT_EQ(refusal(R"({"a": 1e999})"), "a: a number too large for a double");
}

TEST(JSONReader, RefusesAKeyThatStandsTwice) {
    EXPECT_EQ(refusal(R"([{"odd key": 1, "odd key": 1}])"), R"([0]["odd key"]: the key stands twice)");
    EXPECT_EQ(refusal(R"({"a": 1, "\u0061": 2})"), "a: the key stands twice");
}

TEST(JSONReader, SaysLineAndColumnOfWhatIsNoJSON) {
    EXPECT_EQ(refusal("{\n  \"a\": nul\n}").substr(0, 32), "line 2, column 11: not valid JSO");
    EXPECT_EQ(refusal("").substr(0, 32), "line 1, column 1: not valid JSON");
    EXPECT_EQ(refusal("[1] 2").substr(0, 17), "line 1, column 5:");
    EXPECT_EQ(refusal("[1,]").substr(0, 17), "line 1, column 4:");
    EXPECT_EQ(refusal("[\"\\ud800\"]").substr(0, 7), "line 1,");
}

TEST(JSONReader, ReadsOnBehindANulByte) {
    using namespace std::string_view_literals;
    EXPECT_EQ(refusal("[1]\n\0"sv), "line 2, column 1: not valid JSON: a NUL byte behind the value");
    EXPECT_EQ(refusal("[1]\0 [2]"sv), "line 1, column 4: not valid JSON: a NUL byte behind the value");
    EXPECT_EQ(refusal("[1,\0]"sv).substr(0, 32), "line 1, column 4: not valid JSON");
    EXPECT_EQ(refusal("[\"\0\"]"sv).substr(0, 32), "line 1, column 3: not valid JSON");
    EXPECT_EQ(accepted(R"("\u0000")"), Value(std::string(1, '\0')));
}

TEST(JSONReader, SaysWhereUTF8IsInvalid) {
    EXPECT_EQ(refusal("[\n\"a\xff\"]"), "line 2, column 3: invalid UTF-8");
    EXPECT_EQ(refusal("\"\xed\xa0\x80\""), "line 1, column 3: invalid UTF-8");
}

TEST(JSONReader, RefusesWhatIsNestedTooDeeply) {
    std::string deep = std::string(65, '[') + std::string(65, ']');
    EXPECT_EQ(refusal(deep).substr(0, 6), "[0][0]");
    EXPECT_NE(refusal(deep).find("nested deeper than 64 levels"), std::string::npos);
    EXPECT_EQ(refusal(deep.substr(1, 128)), "accepted");
    EXPECT_NE(refusal(std::string(1'000'000, '[')), "accepted");
}

TEST(JSONReader, RefusesATextBeyondTheLimit) {
    EXPECT_EQ(refusal("[1, 2]", {.bytes = 5}), "longer than 5 bytes");
}

TEST(JSONReader, NeverPutsControlCharactersIntoARefusal) {
    std::string text = refusal("[\"a\nb\x1b[31m\"]");
    for (char c : text) EXPECT_GE(static_cast<unsigned char>(c), 0x20) << text;
}

}  // namespace
}  // namespace wp
