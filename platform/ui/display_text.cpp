#include "platform/ui/display_text.h"

#include <array>
#include <cstdio>

#include "platform/ui/code_point_ranges.h"

namespace wp::ui {
namespace {

// Unicode 15: the line and paragraph separators and everything with the property
// Default_Ignorable_Code_Point (zero-width, direction, tag and filler characters), then the interlinear
// annotation characters and the noncharacters at the end of the first plane. Sorted.
constexpr std::array kWithoutGlyph = std::to_array<CodePointRange>({
    {0x00AD, 0x00AD},
    {0x034F, 0x034F},
    {0x061C, 0x061C},
    {0x115F, 0x1160},
    {0x17B4, 0x17B5},
    {0x180B, 0x180F},
    {0x200B, 0x200F},
    {0x2028, 0x202E},
    {0x2060, 0x206F},
    {0x3164, 0x3164},
    {0xFE00, 0xFE0F},
    {0xFEFF, 0xFEFF},
    {0xFFA0, 0xFFA0},
    {0xFFF0, 0xFFFB},
    {0xFFFE, 0xFFFF},
    {0x1BCA0, 0x1BCA3},
    {0x1D173, 0x1D17A},
    {0xE0000, 0xE0FFF},
});

// Where a text or emoji presentation may be chosen (emoji-variation-sequences.txt, taken as blocks).
constexpr std::array kWithTwoPresentations = std::to_array<CodePointRange>({
    {0x0023, 0x0023}, {0x002A, 0x002A}, {0x0030, 0x0039}, {0x00A9, 0x00A9}, {0x00AE, 0x00AE},
    {0x203C, 0x203C}, {0x2049, 0x2049}, {0x2122, 0x2122}, {0x2139, 0x2139}, {0x2194, 0x21AA},
    {0x231A, 0x23FA}, {0x24C2, 0x24C2}, {0x25AA, 0x25FE}, {0x2600, 0x27BF}, {0x2934, 0x2935},
    {0x2B05, 0x2B55}, {0x3030, 0x3030}, {0x303D, 0x303D}, {0x3297, 0x3299}, {0x1F004, 0x1F6FF},
});

bool isControl(char32_t c) {
    return c < 0x20 || (c >= 0x7F && c <= 0x9F);
}

std::string escaped(const char* format, unsigned value) {
    std::array<char, 16> buffer{};
    std::snprintf(buffer.data(), buffer.size(), format, value);
    return buffer.data();
}

std::string byteEscape(unsigned value) {
    return escaped("\\x%02X", value);
}

std::optional<int> lengthOfSequence(unsigned char lead) {
    if (lead < 0x80) return 1;
    if (lead >= 0xC2 && lead <= 0xDF) return 2;
    if (lead >= 0xE0 && lead <= 0xEF) return 3;
    if (lead >= 0xF0 && lead <= 0xF4) return 4;
    return std::nullopt;
}

std::optional<char32_t> decoded(std::string_view sequence) {
    constexpr std::array<char32_t, 5> kSmallest = {0, 0, 0x80, 0x800, 0x10000};
    auto lead = static_cast<unsigned char>(sequence[0]);
    if (sequence.size() == 1) return lead;
    char32_t value = lead & (0xFFU >> (sequence.size() + 1));
    for (char c : sequence.substr(1)) {
        auto byte = static_cast<unsigned char>(c);
        if ((byte & 0xC0) != 0x80) return std::nullopt;
        value = (value << 6) | (byte & 0x3F);
    }
    bool isSurrogate = value >= 0xD800 && value <= 0xDFFF;
    if (value < kSmallest[sequence.size()] || value > 0x10FFFF || isSurrogate) return std::nullopt;
    return value;
}

bool choosesPresentation(char32_t c, std::optional<char32_t> before) {
    return (c == 0xFE0E || c == 0xFE0F) && before && isIn(kWithTwoPresentations, *before);
}

}  // namespace

Utf8Character takeCharacter(std::string_view& text) {
    Utf8Character taken;
    auto length = static_cast<std::size_t>(lengthOfSequence(static_cast<unsigned char>(text[0])).value_or(0));
    if (length > 0 && length <= text.size()) taken.value = decoded(text.substr(0, length));
    taken.bytes = text.substr(0, taken.value ? length : 1);
    text.remove_prefix(taken.bytes.size());
    return taken;
}

std::string encodeUtf8(char32_t c) {
    auto tail = [c](int shift) { return static_cast<char>(0x80 | ((c >> shift) & 0x3F)); };
    if (c < 0x80) return {static_cast<char>(c)};
    if (c < 0x800) return {static_cast<char>(0xC0 | (c >> 6)), tail(0)};
    if (c < 0x10000) return {static_cast<char>(0xE0 | (c >> 12)), tail(6), tail(0)};
    return {static_cast<char>(0xF0 | (c >> 18)), tail(12), tail(6), tail(0)};
}

std::string displayForm(std::string_view text) {
    std::string form;
    form.reserve(text.size());
    std::optional<char32_t> before;
    while (!text.empty()) {
        Utf8Character next = takeCharacter(text);
        if (!next.value) {
            form += byteEscape(static_cast<unsigned char>(next.bytes[0]));
        } else if (isControl(*next.value)) {
            form += byteEscape(*next.value);
        } else if (isIn(kWithoutGlyph, *next.value) && !choosesPresentation(*next.value, before)) {
            form += escaped("\\u{%04X}", *next.value);
        } else {
            form += next.bytes;
        }
        before = next.value;
    }
    return form;
}

}  // namespace wp::ui
