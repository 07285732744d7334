#include "platform/value.h"

#include <gtest/gtest.h>

#include <thread>

#include "platform/records.h"

namespace wp {
namespace {

TEST(Value, KeepsTheKindThatItWasMadeWith) {
    EXPECT_TRUE(Value(true).as<bool>());
    EXPECT_TRUE(Value(1).as<std::int64_t>());
    EXPECT_TRUE(Value(1u).as<std::uint64_t>());
    EXPECT_TRUE(Value(1.0).as<double>());
    EXPECT_TRUE(Value("a").as<std::string>());
    EXPECT_FALSE(Value(1).as<bool>());
    EXPECT_NE(Value(1), Value(1u));
    EXPECT_NE(Value(1), Value(true));
}

TEST(Value, ANullMarkerIsAValueAndNotTheLackOfAKey) {
    DictionaryPointer dictionary = Dictionary::make({{"null", NullMarker{}}});

    EXPECT_TRUE(dictionary->value("null")->isNull());
    EXPECT_FALSE(dictionary->value("absent").has_value());
}

TEST(Value, ACopySharesItsDictionaryWithTheOriginal) {
    Value original(Dictionary::make());
    Value copy = original;

    (*copy.as<DictionaryPointer>())->setValue("key", 7);

    EXPECT_EQ((*original.as<DictionaryPointer>())->value("key"), Value(7));
}

TEST(Value, RecordsAreEqualOnlyWhenTheyAreTheSameObject) {
    auto channel = std::make_shared<const WiFiChannel>(6);

    EXPECT_EQ(Value(channel), Value(channel));
    EXPECT_NE(Value(channel), Value(std::make_shared<const WiFiChannel>(6)));
    EXPECT_EQ(Value(channel).asRecord<WiFiChannel>(), channel);
    EXPECT_EQ(Value(channel).asRecord<WiFiStatus>(), nullptr);
}

TEST(Value, ArraysAndDictionariesAreEqualByContent) {
    EXPECT_EQ(Value(Array{1, "two"}), Value(Array{1, "two"}));
    EXPECT_NE(Value(Array{1}), Value(Array{2}));
    EXPECT_EQ(Value(Dictionary::make({{"a", 1}})), Value(Dictionary::make({{"a", 1}})));
    EXPECT_NE(Value(Dictionary::make({{"a", 1}})), Value(Dictionary::make({{"b", 1}})));
}

TEST(Dictionary, CanBeWrittenByTwoThreadsAtOnce) {
    DictionaryPointer dictionary = Dictionary::make();
    auto write = [&](const char* key) {
        for (int i = 0; i < 1000; ++i) dictionary->setValue(key, i);
    };

    std::thread first(write, "first");
    std::thread second(write, "second");
    first.join();
    second.join();

    EXPECT_EQ(dictionary->entries(), (Dictionary::Entries{{"first", 999}, {"second", 999}}));
}

}  // namespace
}  // namespace wp
