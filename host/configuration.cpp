#include "host/configuration.h"

#include "exchange/object_reader.h"
#include "host/exit.h"
#include "host/files.h"

namespace wp::host {
namespace {

std::map<std::string, bool, std::less<>> readCapabilities(const Value& json, const Place& place) {
    const DictionaryPointer* flags = json.as<DictionaryPointer>();
    if (!flags) place.refuse("must be an object of flags by name");
    std::map<std::string, bool, std::less<>> capabilities;
    for (const auto& [name, value] : (*flags)->entries())
        capabilities.emplace(name, readFlag(value, Place(place, name)));
    return capabilities;
}

Configuration readObject(const Value& json) {
    Place top;
    ObjectReader reader(json, top);
    Configuration configuration;
    if (const Value* capabilities = reader.find("capabilities"))
        configuration.capabilities = readCapabilities(*capabilities, Place(top, "capabilities"));
    for (const char* section : {"endpoints", "vendors", "thresholds"}) {
        const Value* value = reader.find(section);
        if (!value) continue;
        if (!value->as<DictionaryPointer>()) Place(top, section).refuse("must be an object");
        configuration.concernsService = true;
    }
    reader.finish();
    return configuration;
}

}  // namespace

Configuration readConfiguration(const std::string& file) {
    std::string place = "--config: " + file + ": ";
    std::variant<Value, Refusal> json = readJSON(readFile("--config", file));
    if (const Refusal* refusal = std::get_if<Refusal>(&json)) refuse(place + refusal->text());
    try {
        return readObject(std::get<Value>(json));
    } catch (const Refused& refused) {
        refuse(place + refused.what());
    }
}

bool StatedCapabilities::booleanAnswer(std::string_view capability) const {
    auto found = capabilities_.find(capability);
    return found != capabilities_.end() && found->second;
}

}  // namespace wp::host
