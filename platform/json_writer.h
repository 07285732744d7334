#pragma once

#include <string>

#include "platform/value.h"

namespace wp {

enum class JSONStyle {
    compact,   ///< one line, no blanks outside texts
    indented,  ///< two blanks a level, one entry a line, a blank after each colon
};

/// The value as JSON text in UTF-8, without a final newline. *Any* thread.
///
/// Keys are sorted. Null markers, NaN and infinities are `null`; every other number keeps its kind (`1`,
/// `1.0`), doubles as the shortest decimal that reads back to them. Control characters, U+007F to U+009F,
/// U+2028 and U+2029 are escaped, bytes that are no UTF-8 become U+FFFD. A date is its ISO 8601 text. A
/// record has no JSON form of its own and is written as `null`: whoever wants it written turns it into a
/// dictionary.
std::string jsonText(const Value& value, JSONStyle style);

/// The double that `jsonText` writes as the shortest decimal that reads back to this single-precision number.
/// *Any* thread.
double shortestDecimal(float number);

}  // namespace wp
