#pragma once

#include <string>
#include <utility>
#include <variant>

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
    Known() : content_(failure(Reason::unavailable, "not looked for")) {}
    Known(T value) : content_(std::move(value)) {}
    Known(Error error) : content_(std::move(error)) {}

    explicit operator bool() const { return content_.index() == 0; }
    /// The value; only where there is one.
    const T& operator*() const { return *std::get_if<0>(&content_); }
    const T* operator->() const { return std::get_if<0>(&content_); }
    T& operator*() { return *std::get_if<0>(&content_); }
    T* operator->() { return std::get_if<0>(&content_); }
    /// The reason; only where there is no value.
    const Error& error() const { return *std::get_if<1>(&content_); }

  private:
    std::variant<T, Error> content_;
};

}  // namespace wp
