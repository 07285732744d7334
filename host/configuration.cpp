#include "host/configuration.h"

#include <filesystem>
#include <variant>

#include "exchange/json_reader.h"
#include "exchange/wire.h"
#include "host/exit.h"
#include "host/modules/module_entry.h"
#include "platform/json_writer.h"

namespace wp::host {
namespace {

constexpr const char* kServiceFileName = "wifi-profile-service";
/// A service reads its configuration in milliseconds; one that says nothing for so long hangs.
constexpr std::chrono::seconds kLongestStart{10};

ServiceProcess startedProcess(const std::string& program, const std::vector<std::string>& arguments) {
    if (!std::filesystem::exists(program))
        fail(program + ": not found; a live run needs it beside the program (--replay and --demo do not)");
    std::variant<ServiceProcess, Refusal> started = ServiceProcess::start(program, arguments);
    if (const Refusal* refusal = std::get_if<Refusal>(&started)) fail(refusal->text());
    return std::get<ServiceProcess>(std::move(started));
}

Greeting greetingOf(ServiceProcess& process, const std::string& program) {
    const std::optional<std::string> line = process.firstLine(kLongestStart);
    if (!line) {
        const std::optional<std::string> how = process.waitForEnd(std::chrono::milliseconds(100));
        fail(program + ": tells no configuration: " + (how ? "it ended (" + *how + ")" : "it hangs"));
    }
    std::variant<Greeting, Refusal> greeting = readGreeting(*line);
    if (const Refusal* refusal = std::get_if<Refusal>(&greeting))
        fail(program + ": tells the configuration in a form of its own: " + refusal->text());
    return std::get<Greeting>(std::move(greeting));
}

/// A file's name as the service's line carries it: what is no UTF-8 is replaced there.
std::string asTold(const std::string& file) {
    const std::variant<Value, Refusal> told = readJSON(jsonText(Value(file), JSONStyle::compact));
    const Value* value = std::get_if<Value>(&told);
    const std::string* text = value ? value->as<std::string>() : nullptr;
    return text ? *text : file;
}

DictionaryPointer readDictionary(ObjectReader& object, std::string_view key) {
    if (const auto* dictionary = object.need(key).as<DictionaryPointer>()) return *dictionary;
    Place(object.place(), key).refuse("must be an object");
}

Configuration configurationFrom(const DictionaryPointer& told) {
    const Place top;
    ObjectReader object(told, top);
    Configuration configuration;
    configuration.capabilities = readFlags(object.need("capabilities"), Place(top, "capabilities"));
    configuration.thresholds = readDictionary(object, "thresholds");
    configuration.endpoints = readDictionary(object, "endpoints");
    object.finish();
    return configuration;
}

}  // namespace

StartedService startService(const std::optional<std::string>& named,
                            const std::optional<std::string>& interfaceName) {
    const std::string program = (programFolder() / kServiceFileName).string();
    std::vector<std::string> arguments;
    if (interfaceName) arguments = {"--interface", *interfaceName};
    if (named) arguments.insert(arguments.end(), {"--config", *named});
    ServiceProcess process = startedProcess(program, arguments);
    const Greeting greeting = greetingOf(process, program);
    if (!greeting.configuration) {
        const std::string told = named ? asTold(*named) : "";
        const bool isNamed = named && greeting.refused.starts_with(told + ": ");
        refuse(isNamed ? "--config: " + *named + greeting.refused.substr(told.size())
                       : "configuration: " + greeting.refused);
    }
    try {
        return {std::move(process), configurationFrom(greeting.configuration)};
    } catch (const Refused& refused) {
        fail(program + ": tells the configuration in a form of its own: " + refused.what());
    }
}

Configuration readConfiguration(const std::optional<std::string>& named) {
    return startService(named, std::nullopt).configuration;
}

bool StatedCapabilities::booleanAnswer(std::string_view capability) const {
    auto found = capabilities_.find(capability);
    return found != capabilities_.end() && found->second;
}

}  // namespace wp::host
