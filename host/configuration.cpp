#include "host/configuration.h"

#include <filesystem>
#include <variant>

#include "exchange/object_reader.h"
#include "host/exit.h"
#include "host/service_program.h"

namespace wp::host {
namespace {

/// The service's first line on standard error, without its own name.
std::string firstLine(const std::string& text) {
    const std::string name = kServiceFileName + std::string(": ");
    std::string line = text.substr(0, text.find('\n'));
    return line.starts_with(name) ? line.substr(name.size()) : line;
}

/// What the service prints of its configuration when it is called with the option.
std::string shown(const std::string& option, const std::optional<std::string>& named) {
    const std::string service = serviceProgram();
    if (!std::filesystem::exists(service))
        fail(service + ": not found; a live run needs it beside the program (--replay and --demo do not)");
    std::vector<std::string> arguments = {option};
    if (named) arguments.insert(arguments.end(), {"--config", *named});
    const ProgramOutput printed = runProgram(service, arguments);
    if (printed.status == exit_status::ok) return printed.standardOutput;
    const std::string line = firstLine(printed.standardError);
    const bool isNamed = named && line.starts_with(*named + ": ");
    if (printed.status == exit_status::unusable) refuse((isNamed ? "--config: " : "configuration: ") + line);
    fail(service + ": cannot read the configuration: " +
         (line.empty() ? "it ended with status " + std::to_string(printed.status) : line));
}

}  // namespace

Configuration readConfiguration(const std::optional<std::string>& named) {
    const auto json = readJSON(shown("--show-host-part", named));
    Configuration configuration;
    try {
        if (const Refusal* refusal = std::get_if<Refusal>(&json)) throw Refused(*refusal);
        const Place top;
        ObjectReader object(std::get<Value>(json), top);
        configuration.capabilities = readFlags(object.need("capabilities"), Place(top, "capabilities"));
        if (const auto* thresholds = object.need("thresholds").as<DictionaryPointer>())
            configuration.thresholds = *thresholds;
    } catch (const Refused& refused) {
        fail(serviceProgram() + ": tells the configuration in a form of its own: " + refused.what());
    }
    return configuration;
}

std::string contactedEndpoints(const std::optional<std::string>& named) {
    return shown("--show-endpoints", named);
}

bool StatedCapabilities::booleanAnswer(std::string_view capability) const {
    auto found = capabilities_.find(capability);
    return found != capabilities_.end() && found->second;
}

}  // namespace wp::host
