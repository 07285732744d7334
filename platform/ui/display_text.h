#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace wp::ui {

/// One step through UTF-8 text.
struct Utf8Character {
    /// Nothing where the byte belongs to no valid sequence; `bytes` is then that one byte.
    std::optional<char32_t> value;
    std::string_view bytes;
};

/// Takes the first code point off the text, which must not be empty. Overlong forms, surrogates and values
/// beyond U+10FFFF are not valid. *Any* thread.
Utf8Character takeCharacter(std::string_view& text);

/// The UTF-8 form of a code point.
std::string encodeUtf8(char32_t codePoint);

/// The form in which a text that may hold a name from the air is shown, on every screen: what could hide,
/// reorder or command is replaced by a visible escape, everything else stays as it is.
///
/// Replaced are control characters and bytes that are no UTF-8 (`\x1B`), and line and paragraph separators,
/// direction controls, zero-width, tag and other characters without a glyph (`\u{202E}`). A variation
/// selector stays only after a character that has two presentations. For display only: names are compared,
/// stored and asked about in their own form. *Any* thread.
std::string displayForm(std::string_view text);

}  // namespace wp::ui
