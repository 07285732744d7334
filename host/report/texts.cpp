#include "host/report/texts.h"

#include <cstdio>

namespace wp::host {
namespace {

const std::string* valueNamed(std::string_view name, const TextValues& values) {
    for (const auto& [each, value] : values)
        if (each == name) return &value;
    return nullptr;
}

/// Calls `onText` and `onPlace` for the parts of a text in their order.
template <class OnText, class OnPlace>
void takeApart(std::string_view text, OnText onText, OnPlace onPlace) {
    while (!text.empty()) {
        std::size_t open = text.find('{');
        std::size_t close = open == text.npos ? text.npos : text.find('}', open);
        if (close == text.npos) return onText(text);
        onText(text.substr(0, open));
        onPlace(text.substr(open + 1, close - open - 1));
        text.remove_prefix(close + 1);
    }
}

}  // namespace

std::vector<std::string> placesOf(std::string_view text) {
    std::vector<std::string> places;
    takeApart(
        text, [](std::string_view) {}, [&](std::string_view name) { places.emplace_back(name); });
    return places;
}

Texts::Texts(std::string_view table)
    : language_(table), showsKeys_(table == kKeysTableName), table_(reportTable(table)) {}

std::string Texts::text(std::string_view key, const TextValues& values) const {
    auto found = table_.find(key);
    if (found == table_.end()) return std::string(key);
    std::string filled(showsKeys_ ? key : "");
    takeApart(
        found->second, [&](std::string_view part) { filled += showsKeys_ ? "" : part; },
        [&](std::string_view name) {
            const std::string* value = valueNamed(name, values);
            if (showsKeys_) filled += ' ';
            // Where there is nothing to name, its blank goes too.
            bool isNothing = value && value->empty() && !showsKeys_;
            if (isNothing && filled.ends_with(' ')) filled.pop_back();
            filled += value ? *value : "{" + std::string(name) + "}";
        });
    return filled;
}

std::string Texts::space() const {
    // A comma of a script without blanks brings its own room.
    return static_cast<unsigned char>(text("LIST_COMMA").back()) < 0x80 ? " " : "";
}

std::string Texts::aside(const std::string& text) const {
    if (text.empty()) return "";
    return space().empty() ? "（" + text + "）" : " (" + text + ")";
}

std::string Texts::list(const std::vector<std::string>& words) const {
    std::string all;
    for (const std::string& word : words) all += (all.empty() ? "" : text("LIST_COMMA") + space()) + word;
    return all;
}

std::string Texts::number(double value, int decimals) const {
    char digits[64];
    std::snprintf(digits, sizeof digits, "%.*f", decimals, value);
    std::string text = digits;
    auto mark = table_.find("DECIMAL_MARK");
    std::size_t point = text.find('.');
    if (point != text.npos && mark != table_.end()) text.replace(point, 1, mark->second);
    return text;
}

}  // namespace wp::host
