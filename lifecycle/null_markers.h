#pragma once

#include <optional>
#include <string>

#include "platform/extension.h"
#include "platform/value.h"

// Exported under their plain names. They hand out C++ values all the same: caller and callee are always this
// system's own.
#ifdef __clang__
#pragma clang diagnostic push
#pragma clang diagnostic ignored "-Wreturn-type-c-linkage"
#endif

extern "C" {

/// The string (also an empty one), or the null marker where there is none. *Any* thread, as all of these.
WP_EXPORT wp::Value stringOrNull(const std::optional<std::string>& string);

/// The number, or the null marker where there is none.
WP_EXPORT wp::Value numberOrNull(const std::optional<wp::Value>& number);

/// The very dictionary, or the null marker where the pointer is null.
WP_EXPORT wp::Value dictionaryOrNull(const wp::DictionaryPointer& dictionary);

/// The number, also an infinite one, or the null marker for NaN.
WP_EXPORT wp::Value numberOrNullForDouble(double number);

/// Removes every entry whose value is the null marker, or is a reference to nothing. Does not descend into
/// nested dictionaries or arrays. A null pointer is left alone.
WP_EXPORT void removeNullFromDictionary(const wp::DictionaryPointer& dictionary);

}  // extern "C"

#ifdef __clang__
#pragma clang diagnostic pop
#endif
