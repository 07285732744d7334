#pragma once

#include <algorithm>
#include <iterator>

namespace wp::ui {

struct CodePointRange {
    char32_t first;
    char32_t last;
};

/// Whether one of the ranges, which are sorted, holds the code point. *Any*.
bool isIn(const auto& ranges, char32_t codePoint) {
    auto after =
        std::upper_bound(std::begin(ranges), std::end(ranges), codePoint,
                         [](char32_t value, const CodePointRange& range) { return value < range.first; });
    return after != std::begin(ranges) && codePoint <= std::prev(after)->last;
}

}  // namespace wp::ui
