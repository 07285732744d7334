#pragma once

#include <cstddef>
#include <string_view>

namespace wp::ui {

/// One code point of a UTF-8 text. A byte that begins no valid sequence counts as one code point of its own,
/// U+FFFD.
struct CodePoint {
    char32_t value = 0;
    std::size_t length = 1;  ///< bytes
};

/// The code point at the byte position, which must be inside the text.
CodePoint codePointAt(std::string_view text, std::size_t position);

/// Columns that the code point takes in a grid of cells: 0 (combining, joiner, variation selector), 1, or 2
/// (East Asian wide, emoji).
int cellWidth(char32_t codePoint);

/// The byte position where the user-perceived character that begins at the position ends: a base with its
/// combining marks, a joined emoji, a pair of regional indicators. The text's size at the end.
std::size_t nextBoundary(std::string_view text, std::size_t position);

/// The byte position where the user-perceived character that ends at the position begins; 0 at the start.
std::size_t previousBoundary(std::string_view text, std::size_t position);

}  // namespace wp::ui
