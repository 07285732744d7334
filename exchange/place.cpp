#include "exchange/place.h"

#include <algorithm>

#include "platform/json_writer.h"

namespace wp {
namespace {

bool isWordCharacter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '_';
}

}  // namespace

void appendKey(std::string& path, std::string_view key) {
    constexpr std::size_t longest = 64;
    if (!key.empty() && key.size() <= longest && std::all_of(key.begin(), key.end(), isWordCharacter)) {
        if (!path.empty()) path += '.';
        path += key;
    } else {
        path += '[' + jsonText(key.substr(0, longest), JSONStyle::compact) + ']';
    }
}

std::string Place::text() const {
    if (!parent_) return {};
    std::string path = parent_->text();
    if (isIndex_) {
        path += '[' + std::to_string(index_) + ']';
    } else {
        appendKey(path, key_);
    }
    return path;
}

void Place::refuse(std::string reason) const {
    throw Refused({text(), std::move(reason)});
}

}  // namespace wp
