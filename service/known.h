#pragma once

#include <optional>
#include <string>
#include <utility>

#include "platform/error.h"

namespace wp {

/// Why a fact or a verdict cannot be had: the codes of the service's errors.
enum class Reason : int {
    noInterface = 1,
    notJoined = 2,
    notFound = 3,
    unavailable = 4,
    unsupported = 5,
    notPermitted = 6,
    timeout = 7,
    cancelled = 8,
    badConfiguration = 9,
    malformed = 10,
};

inline Error failure(Reason reason, std::string message) {
    return {static_cast<int>(reason), std::move(message)};
}

/// A value, or the reason why it cannot be told. "Cannot tell" is never one of the values.
template <class T>
class Known {
  public:
    Known() : error_(failure(Reason::unavailable, "not looked for")) {}
    Known(T value) : value_(std::move(value)) {}
    Known(Error error) : error_(std::move(error)) {}

    explicit operator bool() const { return value_.has_value(); }
    /// The value; only where there is one.
    const T& operator*() const { return *value_; }
    const T* operator->() const { return &*value_; }
    T& operator*() { return *value_; }
    T* operator->() { return &*value_; }
    /// The reason; only where there is no value.
    const Error& error() const { return error_; }

  private:
    // No variant: to copy and move one takes the compiler twice as long, for every kind of fact.
    std::optional<T> value_;
    Error error_;
};

}  // namespace wp
