#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "platform/value.h"

namespace wp {

/// Typed reads of a request's parameter dictionary. Every read that its key does not satisfy sets one shared
/// failed flag, which no later read clears, and the first reason is kept for the host to show. Numbers,
/// booleans and strings are told apart strictly: a boolean is no number, and neither is a text of digits.
/// *Main*.
class ParameterReader {
  public:
    explicit ParameterReader(DictionaryPointer parameters) : parameters_(std::move(parameters)) {}

    /// The number under the key when it lies within the bounds (both allowed), with the kind that it has.
    std::optional<Value> requiredNumber(std::string_view key, std::uint64_t lowerBound,
                                        std::uint64_t upperBound);

    /// The boolean under the key; false when the read fails.
    bool requiredBool(std::string_view key);

    /// The string under the key when it has no more than `maximumLength` characters (Unicode code points);
    /// the default when the key is missing.
    std::optional<std::string> optionalString(std::string_view key, std::size_t maximumLength,
                                              std::optional<std::string> defaultValue);

    bool failed() const { return !reason_.empty(); }
    /// One line that names the first key that failed and why; empty when none has.
    const std::string& reason() const { return reason_; }

  private:
    void fail(std::string_view key, const std::string& why);

    DictionaryPointer parameters_;
    std::string reason_;
};

}  // namespace wp
