#pragma once

#include <ostream>

#include "platform/value.h"

namespace wp {

/// How GoogleTest shows a value that is not as wanted.
inline void PrintTo(const Value& value, std::ostream* out) {
    struct Printer {
        std::ostream& out;
        void operator()(NullMarker) { out << "null"; }
        void operator()(bool flag) { out << (flag ? "true" : "false"); }
        void operator()(std::int64_t number) { out << number; }
        void operator()(std::uint64_t number) { out << number << "u"; }
        void operator()(double number) { out << number << "d"; }
        void operator()(const std::string& text) { out << '"' << text << '"'; }
        void operator()(Date date) { out << "date " << date.secondsSinceReference; }
        void operator()(const RecordPointer& record) { out << "record at " << record.get(); }
        void operator()(const ArrayPointer& array) {
            out << "[";
            if (array) {
                for (const Value& element : *array) {
                    PrintTo(element, &out);
                    out << " ";
                }
            }
            out << "]";
        }
        void operator()(const DictionaryPointer& dictionary) {
            out << "{";
            if (dictionary) {
                for (const auto& [key, element] : dictionary->entries()) {
                    out << key << ": ";
                    PrintTo(element, &out);
                    out << " ";
                }
            }
            out << "}";
        }
    };
    std::visit(Printer{*out}, value.storage());
}

}  // namespace wp
