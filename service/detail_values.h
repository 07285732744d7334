#pragma once

#include <cmath>
#include <optional>
#include <string_view>
#include <vector>

#include "service/band.h"
#include "service/details.h"

namespace wp {

// Small helpers of the functions in details.h.

/// The entry, where there is a value.
template <class T>
void addKnown(Details& details, std::string_view key, const std::optional<T>& value) {
    if (value) details.emplace(key, *value);
}

inline void addText(Details& details, std::string_view key, const std::string& text) {
    if (!text.empty()) details.emplace(key, text);
}

/// An array of what the function makes of each element.
template <class Range, class Function>
Value listOf(const Range& range, Function function) {
    Array elements;
    for (const auto& each : range) elements.emplace_back(function(each));
    return elements;
}

/// With three decimals: a measured time or share is not known any better.
inline double rounded(double number) {
    return std::round(number * 1000) / 1000;
}

inline std::optional<double> rounded(const std::optional<double>& number) {
    return number ? std::optional(rounded(*number)) : std::nullopt;
}

inline std::string_view wordOf(Band band) {
    switch (band) {
        case Band::ghz2:
            return "2.4GHz";
        case Band::ghz5:
            return "5GHz";
        case Band::ghz6:
            return "6GHz";
        case Band::none:
            break;
    }
    return "other";
}

inline void addThresholds(Details& details, Dictionary::Entries thresholds) {
    details.emplace("Thresholds", Dictionary::make(std::move(thresholds)));
}

}  // namespace wp
