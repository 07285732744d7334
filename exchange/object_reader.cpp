#include "exchange/object_reader.h"

#include <algorithm>
#include <limits>

namespace wp {
namespace {

std::string integerReason(std::int64_t least, std::int64_t most) {
    using Limits = std::numeric_limits<std::int64_t>;
    if (least == Limits::min() && most == Limits::max()) return "must be a signed 64-bit integer";
    return "must be an integer from " + std::to_string(least) + " to " + std::to_string(most);
}

}  // namespace

bool readFlag(const Value& json, const Place& place) {
    if (const bool* flag = json.as<bool>()) return *flag;
    place.refuse("must be true or false");
}

std::int64_t readInteger(const Value& json, const Place& place, std::int64_t least, std::int64_t most) {
    const auto* number = json.as<std::int64_t>();
    if (number && *number >= least && *number <= most) return *number;
    place.refuse(integerReason(least, most));
}

double readNumber(const Value& json, const Place& place) {
    if (const auto* number = json.as<double>()) return *number;
    if (const auto* number = json.as<std::int64_t>()) return static_cast<double>(*number);
    if (const auto* number = json.as<std::uint64_t>()) return static_cast<double>(*number);
    place.refuse("must be a number");
}

std::string readText(const Value& json, const Place& place) {
    if (const auto* text = json.as<std::string>()) return *text;
    place.refuse("must be a text");
}

ArrayPointer readArray(const Value& json, const Place& place) {
    if (const auto* array = json.as<ArrayPointer>()) return *array;
    place.refuse("must be an array");
}

Flags readFlags(const Value& json, const Place& place) {
    const auto* object = json.as<DictionaryPointer>();
    if (!object) place.refuse("must be an object");
    Flags flags;
    for (const auto& [name, value] : (*object)->entries())
        flags.emplace(name, readFlag(value, Place(place, name)));
    return flags;
}

ObjectReader::ObjectReader(const Value& json, const Place& place) : place_(place) {
    const auto* object = json.as<DictionaryPointer>();
    if (!object) place.refuse("must be an object");
    entries_ = (*object)->entries();
}

const Value* ObjectReader::find(std::string_view key) {
    known_.push_back(key);
    auto found = entries_.find(key);
    return found == entries_.end() ? nullptr : &found->second;
}

const Value* ObjectReader::findNonNull(std::string_view key) {
    const Value* value = find(key);
    return value && !value->isNull() ? value : nullptr;
}

const Value& ObjectReader::need(std::string_view key) {
    if (const Value* value = find(key)) return *value;
    place_.refuse("needs the key \"" + std::string(key) + '"');
}

void ObjectReader::finish() const {
    for (const auto& [key, value] : entries_) {
        if (std::find(known_.begin(), known_.end(), key) == known_.end())
            Place(place_, key).refuse("unknown key");
    }
}

}  // namespace wp
