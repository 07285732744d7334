#include "service/plain_text.h"

#include <algorithm>

namespace wp {
namespace {

unsigned byteAt(std::string_view text, std::size_t at) {
    return at < text.size() ? static_cast<unsigned char>(text[at]) : 0U;
}

/// The length of the valid UTF-8 sequence at the start of the text, 0 where there is none.
std::size_t sequenceLength(std::string_view text) {
    const unsigned first = byteAt(text, 0), second = byteAt(text, 1);
    if (first < 0x80) return 1;
    const std::size_t length = first >= 0xC2 && first <= 0xDF   ? 2
                               : first >= 0xE0 && first <= 0xEF ? 3
                               : first >= 0xF0 && first <= 0xF4 ? 4
                                                                : 0;
    for (std::size_t i = 1; i < length; ++i)
        if ((byteAt(text, i) & 0xC0) != 0x80) return 0;
    const bool overlong = (first == 0xE0 && second < 0xA0) || (first == 0xF0 && second < 0x90);
    const bool noCharacter = (first == 0xED && second > 0x9F) || (first == 0xF4 && second > 0x8F);
    return overlong || noCharacter ? 0 : length;
}

bool isControl(std::string_view sequence) {
    const unsigned first = byteAt(sequence, 0);
    return first < 0x20 || first == 0x7F || (first == 0xC2 && byteAt(sequence, 1) < 0xA0);
}

std::string escape(unsigned byte) {
    constexpr char kDigits[] = "0123456789ABCDEF";
    return {'\\', 'x', kDigits[byte >> 4], kDigits[byte & 0xF]};
}

}  // namespace

std::string plainText(std::string_view bytes, std::size_t longest) {
    std::string text;
    for (std::size_t at = 0, end = std::min(longest, bytes.size()); at < end;) {
        const std::size_t length = sequenceLength(bytes.substr(at));
        const std::string_view sequence = bytes.substr(at, std::max<std::size_t>(length, 1));
        if (length == 0)
            text += escape(byteAt(bytes, at));
        else if (!isControl(sequence))
            text += sequence;
        at += sequence.size();
    }
    const std::size_t start = text.find_first_not_of(' ');
    if (start == text.npos) return {};
    return text.substr(start, text.find_last_not_of(' ') - start + 1);
}

}  // namespace wp
