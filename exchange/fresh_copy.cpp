#include "exchange/fresh_copy.h"

#include <type_traits>

#include "platform/records.h"

namespace wp {
namespace {

template <class T>
bool copyAs(const RecordPointer& record, Value& into) {
    const auto* original = dynamic_cast<const T*>(record.get());
    if (original) into = std::make_shared<const T>(*original);
    return original != nullptr;
}

Value copyRecord(const RecordPointer& record) {
    Value copy = record;
    copyAs<WiFiScanResult>(record, copy) || copyAs<PreferredNetworkRecord>(record, copy) ||
        copyAs<PingStatistics>(record, copy) || copyAs<WiFiChannel>(record, copy) ||
        copyAs<WiFiStatus>(record, copy);
    return copy;
}

Value copyValue(const Value& value);

DictionaryPointer copyDictionary(const DictionaryPointer& dictionary) {
    if (!dictionary) return nullptr;
    Dictionary::Entries entries = dictionary->entries();
    for (auto& [key, value] : entries) value = copyValue(value);
    return Dictionary::make(std::move(entries));
}

Value copyValue(const Value& value) {
    if (const auto* record = value.as<RecordPointer>()) return copyRecord(*record);
    if (const auto* dictionary = value.as<DictionaryPointer>()) return copyDictionary(*dictionary);
    const auto* array = value.as<ArrayPointer>();
    if (!array || !*array) return value;
    Array elements;
    elements.reserve((*array)->size());
    for (const Value& element : **array) elements.push_back(copyValue(element));
    return elements;
}

}  // namespace

DiagnosticsTestResponse freshCopy(const DiagnosticsTestResponse& response) {
    DiagnosticsTestResponse copy = response;
    if (!copy.results) return copy;
    for (DiagnosticsTestResultPointer& result : *copy.results) {
        if (!result) continue;
        result = std::make_shared<const DiagnosticsTestResult>(
            DiagnosticsTestResult{result->result, result->didPass, copyDictionary(result->info)});
    }
    return copy;
}

}  // namespace wp
