#include "platform/parameter_reader.h"

#include <algorithm>

namespace wp {
namespace {

std::string kindOf(const Value& value) {
    static constexpr const char* kKinds[] = {"null",     "a boolean", "a number", "a number",     "a number",
                                             "a string", "a date",    "an array", "a dictionary", "a record"};
    return kKinds[value.storage().index()];
}

std::optional<double> numberIn(const Value& value) {
    if (auto* number = value.as<std::int64_t>()) return static_cast<double>(*number);
    if (auto* number = value.as<std::uint64_t>()) return static_cast<double>(*number);
    if (auto* number = value.as<double>()) return *number;
    return std::nullopt;
}

std::size_t codePoints(std::string_view text) {
    return static_cast<std::size_t>(std::count_if(
        text.begin(), text.end(), [](char c) { return (static_cast<unsigned char>(c) & 0xC0) != 0x80; }));
}

}  // namespace

void ParameterReader::fail(std::string_view key, const std::string& why) {
    if (failed()) return;
    reason_ = "\"" + std::string(key) + "\" " + why;
}

std::optional<Value> ParameterReader::requiredNumber(std::string_view key, std::uint64_t lowerBound,
                                                     std::uint64_t upperBound) {
    std::string wanted = "a number from " + std::to_string(lowerBound) + " to " + std::to_string(upperBound);
    std::optional<Value> value = parameters_ ? parameters_->value(key) : std::nullopt;
    if (!value) {
        fail(key, "is missing: it must be " + wanted);
        return std::nullopt;
    }
    std::optional<double> number = numberIn(*value);
    if (!number) {
        fail(key, "is " + kindOf(*value) + ": it must be " + wanted);
        return std::nullopt;
    }
    bool isWithin = *number >= static_cast<double>(lowerBound) && *number <= static_cast<double>(upperBound);
    if (!isWithin) {
        fail(key, "is out of bounds: it must be " + wanted);
        return std::nullopt;
    }
    return value;
}

bool ParameterReader::requiredBool(std::string_view key) {
    std::optional<Value> value = parameters_ ? parameters_->value(key) : std::nullopt;
    if (!value) {
        fail(key, "is missing: it must be true or false");
        return false;
    }
    const bool* flag = value->as<bool>();
    if (!flag) fail(key, "is " + kindOf(*value) + ": it must be true or false");
    return flag && *flag;
}

std::optional<std::string> ParameterReader::optionalString(std::string_view key, std::size_t maximumLength,
                                                           std::optional<std::string> defaultValue) {
    std::optional<Value> value = parameters_ ? parameters_->value(key) : std::nullopt;
    if (!value) return defaultValue;
    const std::string* text = value->as<std::string>();
    if (!text) {
        fail(key, "is " + kindOf(*value) + ": it must be a string");
        return std::nullopt;
    }
    std::size_t length = codePoints(*text);
    if (length > maximumLength) {
        fail(key, "has " + std::to_string(length) + " characters: " + std::to_string(maximumLength) +
                      " are allowed");
        return std::nullopt;
    }
    return *text;
}

}  // namespace wp
