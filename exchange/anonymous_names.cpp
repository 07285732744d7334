#include "exchange/anonymous_names.h"

#include <algorithm>
#include <vector>

namespace wp {
namespace {

constexpr std::string_view kNoMap = "_nomap";
/// Names shorter than this are words of any sentence.
constexpr std::size_t kShortestWord = 3;

std::string lowered(std::string_view text) {
    std::string lower(text);
    for (char& c : lower)
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
    return lower;
}

std::size_t characters(std::string_view text) {
    return static_cast<std::size_t>(
        std::count_if(text.begin(), text.end(), [](unsigned char c) { return (c & 0xC0U) != 0x80U; }));
}

std::string replacement(const std::string& name, std::size_t number) {
    std::string digits = std::to_string(number);
    std::string text = "Net " + std::string(digits.size() < 4 ? 4 - digits.size() : 0, '0') + digits;
    bool isNoMap = lowered(name).ends_with(kNoMap);
    std::size_t length = characters(name);
    if (length > 16) {
        text += " with a long name";
    } else if (length > 8 && !isNoMap) {
        text += " nearby";
    }
    return isNoMap ? text + name.substr(name.size() - kNoMap.size()) : text;
}

bool isWordByte(unsigned char c) {
    return (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == '_' ||
           c >= 0x80;
}

/// Whether the part of the text is no piece of a longer word.
bool standsAlone(std::string_view text, std::size_t begin, std::size_t length) {
    auto byte = [&](std::size_t i) { return static_cast<unsigned char>(text[i]); };
    std::size_t end = begin + length;
    bool isJoinedBefore = begin > 0 && isWordByte(byte(begin)) && isWordByte(byte(begin - 1));
    bool isJoinedBehind = end < text.size() && isWordByte(byte(end - 1)) && isWordByte(byte(end));
    return !isJoinedBefore && !isJoinedBehind;
}

}  // namespace

AnonymousNames::AnonymousNames(const std::set<std::string>& names) {
    std::vector<std::string> ordered(names.begin(), names.end());
    std::stable_sort(ordered.begin(), ordered.end(), [](const std::string& left, const std::string& right) {
        return lowered(left) < lowered(right);
    });
    for (const std::string& name : ordered)
        if (!name.empty()) replacements_.emplace(name, replacement(name, replacements_.size() + 1));
}

std::string AnonymousNames::replaced(const std::string& text) const {
    auto found = replacements_.find(text);
    return found == replacements_.end() ? text : found->second;
}

std::string AnonymousNames::replacedWithin(std::string_view text) const {
    std::string out;
    for (std::size_t i = 0; i < text.size();) {
        const std::pair<const std::string, std::string>* longest = nullptr;
        for (const auto& entry : replacements_) {
            const std::string& name = entry.first;
            bool isLonger = name.size() >= (longest ? longest->first.size() + 1 : kShortestWord);
            if (isLonger && text.substr(i, name.size()) == name && standsAlone(text, i, name.size()))
                longest = &entry;
        }
        out += longest ? std::string_view(longest->second) : text.substr(i, 1);
        i += longest ? longest->first.size() : 1;
    }
    return out;
}

}  // namespace wp
