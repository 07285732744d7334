#include "host/request.h"

#include "exchange/json_reader.h"
#include "host/exit.h"
#include "host/files.h"
#include "platform/ui/display_text.h"

namespace wp::host {
namespace {

constexpr std::int64_t kDefaultMaxScanCacheAge = 60;

Value ageFrom(const std::string& text) {
    std::variant<Value, Refusal> read = readJSON(text);
    const Value* value = std::get_if<Value>(&read);
    bool isNumber = value && (value->as<std::int64_t>() || value->as<std::uint64_t>() || value->as<double>());
    if (!isNumber)
        refuse("--max-scan-cache-age: \"" + text + "\" is not a number; give seconds from 0 to 600");
    return *value;
}

bool isUtf8(std::string_view text) {
    while (!text.empty())
        if (!ui::takeCharacter(text).value) return false;
    return true;
}

DictionaryPointer fromShorthands(const RunOptions& options) {
    DictionaryPointer parameters = Dictionary::make();
    parameters->setValue("maxScanCacheAge", options.maxScanCacheAge ? ageFrom(*options.maxScanCacheAge)
                                                                    : Value(kDefaultMaxScanCacheAge));
    parameters->setValue("reprofileWithUI", options.list);
    if (options.network && !isUtf8(*options.network))
        refuse("--network: the name is not UTF-8; give it as text");
    if (options.network) parameters->setValue("networkName", *options.network);
    return parameters;
}

const char* kindOf(const Value& value) {
    if (value.isNull()) return "null";
    if (value.as<bool>()) return "a boolean";
    if (value.as<std::string>()) return "a text";
    if (value.as<ArrayPointer>()) return "an array";
    return "a number";
}

DictionaryPointer fromFile(const std::string& file) {
    std::string place = "--request: " + (file == "-" ? std::string("standard input") : file) + ": ";
    std::variant<Value, Refusal> read = readJSON(readFile("--request", file));
    if (const Refusal* refusal = std::get_if<Refusal>(&read)) refuse(place + refusal->text());
    const Value& value = std::get<Value>(read);
    const DictionaryPointer* parameters = value.as<DictionaryPointer>();
    if (!parameters)
        refuse(place + "the request is " + kindOf(value) + "; it must be an object of parameters");
    return *parameters;
}

}  // namespace

DictionaryPointer requestParameters(const RunOptions& options) {
    return options.requestFile ? fromFile(*options.requestFile) : fromShorthands(options);
}

bool asksForList(const Dictionary& parameters) {
    std::optional<Value> value = parameters.value("reprofileWithUI");
    const bool* flag = value ? value->as<bool>() : nullptr;
    return flag && *flag;
}

}  // namespace wp::host
