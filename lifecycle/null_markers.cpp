#include "lifecycle/null_markers.h"

#include <cmath>

using namespace wp;

namespace {

bool isReferenceToNothing(const Value& value) {
    if (auto* array = value.as<ArrayPointer>()) return !*array;
    if (auto* dictionary = value.as<DictionaryPointer>()) return !*dictionary;
    if (auto* record = value.as<RecordPointer>()) return !*record;
    return false;
}

}  // namespace

Value stringOrNull(const std::optional<std::string>& string) {
    return string ? Value(*string) : Value(NullMarker());
}

Value numberOrNull(const std::optional<Value>& number) {
    return number ? *number : Value(NullMarker());
}

Value dictionaryOrNull(const DictionaryPointer& dictionary) {
    return dictionary ? Value(dictionary) : Value(NullMarker());
}

Value numberOrNullForDouble(double number) {
    return std::isnan(number) ? Value(NullMarker()) : Value(number);
}

void removeNullFromDictionary(const DictionaryPointer& dictionary) {
    if (!dictionary) return;
    for (const auto& [key, value] : dictionary->entries()) {
        if (value.isNull() || isReferenceToNothing(value)) dictionary->removeValue(key);
    }
}
