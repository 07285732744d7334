#include "host/preparation.h"

#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>
#include <string_view>

#include "host/exit.h"
#include "host/files.h"
#include "host/request.h"
#include "host/screen_choice.h"
#include "host/string_table.h"
#include "host/tv_screen.h"
#include "host/unicode/unicode.h"

namespace wp::host {
namespace {

/// The recording holds the names of networks nearby: nobody else's business.
constexpr mode_t kRecordingMode = 0600;

std::shared_ptr<const Recording> loaded(const std::string& option, const std::string& file) {
    std::variant<Recording, Refusal> recording = readRecording(readFile(option, file));
    if (const Refusal* refusal = std::get_if<Refusal>(&recording))
        refuse(option + ": " + file + ": " + refusal->text());
    return std::make_shared<const Recording>(std::get<Recording>(std::move(recording)));
}

std::shared_ptr<const Recording> demo(const std::string& name) {
    const bool isPlain = name.find('/') == std::string::npos && name.front() != '.';
    const std::string place = "recordings/" + name + ".json";
    const std::optional<std::filesystem::path> file = isPlain ? resourceFile(place) : std::nullopt;
    constexpr std::string_view kShipped[] = {"home", "troubled", "selected"};
    if (!file && std::ranges::find(kShipped, name) != std::end(kShipped))
        refuse("--demo: " + installedResource(place).string() + ": not found; it is part of the program");
    if (!file)
        refuse("--demo: no recording \"" + name +
               "\" ships with the program; give home, troubled or selected");
    return loaded("--demo", file->string());
}

std::shared_ptr<const Recording> recordingOf(const RunOptions& options) {
    if (options.replayFile) return loaded("--replay", *options.replayFile);
    if (options.demo) return demo(*options.demo);
    return nullptr;
}

/// The screen is drawn on the controlling terminal, so standard output may lead anywhere.
bool hasTerminal() {
    int terminal = open("/dev/tty", O_RDWR | O_CLOEXEC | O_NOCTTY);
    if (terminal < 0) return false;
    close(terminal);
    return true;
}

bool hasDisplay() {
    auto isNamed = [](const char* variable) {
        const char* value = std::getenv(variable);
        return value && *value;
    };
    return isNamed("WAYLAND_DISPLAY") || isNamed("DISPLAY");
}

ScreenChoice screenOf(const RunOptions& options, const Dictionary& parameters) {
    ScreenSurroundings surroundings;
    surroundings.hasTerminal = hasTerminal();
    surroundings.hasList = asksForList(parameters);
    surroundings.hasScript = options.remote.has_value();
    surroundings.hasDisplay = hasDisplay();
    surroundings.televisionFault = []() -> std::optional<std::string> {
        TvModule::Loaded module = TvModule::load();
        if (std::string* why = std::get_if<std::string>(&module)) return std::move(*why);
        return std::nullopt;
    };
    return chooseScreen(options.screen, surroundings);
}

remote::Script scriptOf(const RunOptions& options, ScreenChoice screen) {
    if (!options.remote) return {};
    remote::Pictures pictures =
        screen == ScreenChoice::tv ? remote::Pictures::taken : remote::Pictures::refused;
    remote::Script script = remote::readScript(*options.remote, pictures);
    if (script.error) refuse("--remote: " + *script.error);
    return script;
}

std::optional<OutputFile> outputFile(const char* option, const std::optional<std::string>& path,
                                     std::optional<mode_t> mode = std::nullopt) {
    if (!path || *path == "-") return std::nullopt;
    return OutputFile(option, *path, mode);
}

}  // namespace

LocaleChoice localeChoice(const std::optional<std::string>& name) {
    if (!name) return localeOfEnvironment();
    if (std::optional<LocaleChoice> choice = localeNamed(*name)) return *choice;
    std::string names;
    for (const std::string& each : stringTableNames()) names += (names.empty() ? "" : ", ") + each;
    refuse("--locale: there are no texts for \"" + *name + "\"; give one of " + names);
}

Preparation prepare(const RunOptions& options) {
    Preparation prepared;
    prepared.locale = localeChoice(options.locale);
    prepared.parameters = requestParameters(options);
    prepared.recording = recordingOf(options);
    // A replay has its capabilities from the recording; a file that was named is read all the same.
    if (!prepared.recording) {
        StartedService started = startService(options.configFile, options.interfaceName);
        prepared.configuration = std::move(started.configuration);
        prepared.service.emplace(std::move(started.process));
    } else if (options.configFile) {
        prepared.configuration = readConfiguration(options.configFile);
    }
    prepared.screen = screenOf(options, *prepared.parameters);
    // Before anything is measured, so that nothing measured is lost.
    if (asksForList(*prepared.parameters) || options.format == OutputFormat::text) needUnicode();
    prepared.script = scriptOf(options, prepared.screen);
    refuseOneFileForTwo({{"--request", options.requestFile, FileUse::read},
                         {"--replay", options.replayFile, FileUse::read},
                         {"--config", options.configFile, FileUse::read},
                         {"--output", options.outputFile, FileUse::written},
                         {"--record", options.recordFile, FileUse::written},
                         {"--automation", options.automationFile, FileUse::written},
                         {"--transcript", options.transcriptFile, FileUse::written}});
    prepared.output = outputFile("--output", options.outputFile);
    prepared.record = outputFile("--record", options.recordFile, kRecordingMode);
    prepared.automation = outputFile("--automation", options.automationFile);
    prepared.transcript = outputFile("--transcript", options.transcriptFile);
    return prepared;
}

}  // namespace wp::host
