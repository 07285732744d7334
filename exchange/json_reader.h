#pragma once

#include <cstddef>
#include <exception>
#include <string>
#include <string_view>
#include <variant>

#include "platform/value.h"

namespace wp {

/// Why a text from outside is not accepted: where in it, and what is wrong there.
struct Refusal {
    std::string place;  ///< a path such as `answers[3].delayMs`, or "line 3, column 7"; empty: the whole
    std::string reason;

    /// One line: "PLACE: REASON".
    std::string text() const { return place.empty() ? reason : place + ": " + reason; }
};

/// A refusal on its way up through the functions that read one text.
class Refused : public std::exception {
  public:
    explicit Refused(Refusal refusal) : refusal_(std::move(refusal)), text_(refusal_.text()) {}
    const Refusal& refusal() const { return refusal_; }
    const char* what() const noexcept override { return text_.c_str(); }

  private:
    Refusal refusal_;
    std::string text_;
};

/// How much a text may ask of its reader.
struct JSONLimits {
    std::size_t bytes = std::size_t{64} << 20;
    std::size_t depth = 64;  ///< arrays and objects around a value
};

/// Reads one JSON value. Integers are signed where they fit and unsigned beyond that; numbers with a fraction
/// or an exponent are doubles. Refused, with the place: anything that is no JSON, invalid UTF-8, a key that
/// stands twice in one object, an integer beyond 64 bits, a number beyond a double, a text beyond the limits.
/// *Any* thread.
std::variant<Value, Refusal> readJSON(std::string_view text, const JSONLimits& limits = {});

}  // namespace wp
