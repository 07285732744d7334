#include "host/arguments.h"

#include <charconv>
#include <cmath>
#include <set>

#include "host/exit.h"

namespace wp::host {
namespace {

enum class Takes { nothing, value, optionalValue };

struct Option {
    const char* name;
    Takes takes;
    const char* placeholder;
    const char* help;
    void (*apply)(RunOptions&, const std::string& value);
};

constexpr const char* kDefaultDemo = "home";
/// A run ends in minutes; a day leaves room and keeps every sum of moments far from overflow.
constexpr double kLongestTimeoutSeconds = 86400;

std::string quoted(const std::string& text) {
    return '"' + text + '"';
}

std::chrono::milliseconds timeoutFrom(const std::string& text) {
    double seconds = 0;
    auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), seconds);
    bool isNumber = error == std::errc() && end == text.data() + text.size() && std::isfinite(seconds);
    if (!isNumber || seconds <= 0 || seconds > kLongestTimeoutSeconds)
        refuse("--timeout: " + quoted(text) + " is not a time; give seconds above 0, at most 86400");
    return std::chrono::milliseconds(static_cast<long long>(std::ceil(seconds * 1000)));
}

ScreenChoice screenFrom(const std::string& text) {
    if (text == "auto") return ScreenChoice::automatic;
    if (text == "tv") return ScreenChoice::tv;
    if (text == "terminal") return ScreenChoice::terminal;
    if (text == "headless") return ScreenChoice::headless;
    if (text == "none") return ScreenChoice::none;
    refuse("--screen: " + quoted(text) + " is no screen; give tv, terminal, headless, none or auto");
}

OutputFormat formatFrom(const std::string& text) {
    if (text == "json") return OutputFormat::json;
    if (text == "text") return OutputFormat::text;
    refuse("--format: " + quoted(text) + " is no format of a run; give json or text");
}

// clang-format off
const Option kOptions[] = {
    {"--request", Takes::value, "FILE", "the request's parameters as a JSON object (-: standard input)",
     [](RunOptions& o, const std::string& v) { o.requestFile = v; }},
    {"--max-scan-cache-age", Takes::value, "N", "accept scans up to N seconds old, 0 to 600 (default 60)",
     [](RunOptions& o, const std::string& v) { o.maxScanCacheAge = v; }},
    {"--list", Takes::nothing, "", "show the list of networks and let the user choose",
     [](RunOptions& o, const std::string&) { o.list = true; }},
    {"--network", Takes::value, "NAME", "profile this network beside the joined one",
     [](RunOptions& o, const std::string& v) { o.network = v; }},
    {"--replay", Takes::value, "FILE", "take all answers from a recording instead of this machine",
     [](RunOptions& o, const std::string& v) { o.replayFile = v; }},
    {"--demo", Takes::optionalValue, "NAME", "replay a recording that ships with the program (default home)",
     [](RunOptions& o, const std::string& v) { o.demo = v.empty() ? kDefaultDemo : v; }},
    {"--record", Takes::value, "FILE", "write what platform and service answered as a recording",
     [](RunOptions& o, const std::string& v) { o.recordFile = v; }},
    {"--anonymise", Takes::nothing, "", "replace names and addresses in the recording consistently",
     [](RunOptions& o, const std::string&) { o.anonymise = true; }},
    {"--interface", Takes::value, "NAME", "the Wi-Fi interface to look at, where there are several",
     [](RunOptions& o, const std::string& v) { o.interfaceName = v; }},
    {"--timeout", Takes::value, "SECONDS", "end the run after that long at the latest",
     [](RunOptions& o, const std::string& v) { o.timeout = timeoutFrom(v); }},
    {"--config", Takes::value, "FILE", "endpoints, vendors, thresholds and capabilities (JSON)",
     [](RunOptions& o, const std::string& v) { o.configFile = v; }},
    {"--show-endpoints", Takes::nothing, "", "print what a live run would contact, and end",
     [](RunOptions& o, const std::string&) { o.showEndpoints = true; }},
    {"--screen", Takes::value, "SCREEN", "tv, terminal, headless, none or auto (default)",
     [](RunOptions& o, const std::string& v) { o.screen = screenFrom(v); }},
    {"--remote", Takes::value, "SCRIPT", "remote-control keys to press (@FILE: from a file)",
     [](RunOptions& o, const std::string& v) { o.remote = v; }},
    {"--transcript", Takes::value, "FILE", "the snapshots that the script asks for (-: standard output)",
     [](RunOptions& o, const std::string& v) { o.transcriptFile = v; }},
    {"--automation", Takes::value, "FILE", "enable test automation; what is posted to it is written there",
     [](RunOptions& o, const std::string& v) { o.automationFile = v; }},
    {"--locale", Takes::value, "NAME", "language of the screen: en, de, ja or x-keys",
     [](RunOptions& o, const std::string& v) { o.locale = v; }},
    {"--output", Takes::value, "FILE", "write the result there instead of to standard output",
     [](RunOptions& o, const std::string& v) { o.outputFile = v; }},
    {"--format", Takes::value, "FORMAT", "json (default) or text",
     [](RunOptions& o, const std::string& v) { o.format = formatFrom(v); }},
    {"--extension", Takes::value, "PATH", "the diagnostic's module, where it is not beside the program",
     [](RunOptions& o, const std::string& v) { o.extension = v; }},
};
// clang-format on

const Option* optionNamed(const std::string& name) {
    for (const Option& option : kOptions)
        if (name == option.name) return &option;
    return nullptr;
}

/// Walks through the words after `run`.
class RunOptionsReader {
  public:
    explicit RunOptionsReader(const std::vector<std::string>& words) : words_(words) {}

    /// Returns whether help was asked for.
    bool readInto(RunOptions& options) {
        while (next_ < words_.size()) {
            if (words_[next_] == "--help" || words_[next_] == "-h") return true;
            readOne(options);
        }
        if (options.showEndpoints) refuseWithoutRun();
        return false;
    }

  private:
    void refuseWithoutRun() const {
        for (const std::string& name : seen_) {
            if (name == "--show-endpoints" || name == "--config" || name == "--interface") continue;
            refuse(name + ": not together with --show-endpoints, which ends without a run");
        }
    }

    void readOne(RunOptions& options) {
        std::string word = words_[next_++];
        if (word.rfind("--", 0) != 0)
            refuse(quoted(word) + " is not an option of run; `wifi-profile run --help` lists them");
        std::optional<std::string> value;
        if (std::size_t equals = word.find('='); equals != std::string::npos) {
            value = word.substr(equals + 1);
            word.resize(equals);
        }
        const Option* option = optionNamed(word);
        if (!option) refuse(word + ": no such option of run; `wifi-profile run --help` lists them");
        if (!seen_.insert(word).second) refuse(word + ": given twice; give it once");
        option->apply(options, valueOf(*option, std::move(value)));
    }

    std::string valueOf(const Option& option, std::optional<std::string> value) {
        bool isLast = next_ == words_.size();
        if (option.takes == Takes::nothing) {
            if (value)
                refuse(std::string(option.name) + ": takes no value; leave out what follows the \"=\"");
            return "";
        }
        if (!value && !isLast && (option.takes == Takes::value || words_[next_].rfind('-', 0) != 0))
            value = words_[next_++];
        if (option.takes == Takes::optionalValue) return value.value_or("");
        if (!value) refuse(std::string(option.name) + ": needs a value, " + option.placeholder);
        if (value->empty() && option.name != std::string("--network") &&
            option.name != std::string("--remote"))
            refuse(std::string(option.name) + ": the value is empty; give " + option.placeholder);
        return *value;
    }

    const std::vector<std::string>& words_;
    std::size_t next_ = 1;
    std::set<std::string> seen_;
};

void refuseConflicts(const RunOptions& options) {
    if (options.requestFile) {
        const char* shorthand = options.maxScanCacheAge ? "--max-scan-cache-age"
                                : options.list          ? "--list"
                                : options.network       ? "--network"
                                                        : nullptr;
        if (shorthand)
            refuse(std::string(shorthand) +
                   ": not together with --request; put the value into the request instead");
    }
    if (options.replayFile && options.demo)
        refuse("--demo: not together with --replay; a run replays one recording");
    if (options.interfaceName && (options.replayFile || options.demo))
        refuse("--interface: not together with " + std::string(options.demo ? "--demo" : "--replay") +
               "; a recording states its devices itself");
    if (options.recordFile == "-") refuse("--record: \"-\" is no file; standard output carries the result");
    if (options.automationFile == "-")
        refuse("--automation: \"-\" is no file; standard output carries the result");
    if (options.anonymise && !options.recordFile)
        refuse("--anonymise: needs --record FILE; it changes what is recorded");
    if (options.transcriptFile == "-" && !options.outputFile)
        refuse("--transcript: \"-\" needs --output FILE, because standard output carries the result");
}

Arguments reportArguments(const std::vector<std::string>& words) {
    if (words.size() < 2) refuse("report: needs the result's FILE (or -)");
    Arguments arguments;
    arguments.command = Command::report;
    arguments.reportFile = words[1];
    return arguments;
}

void refuseMore(const std::vector<std::string>& words) {
    if (words.size() > 1) refuse(quoted(words[1]) + ": " + words[0] + " takes nothing more; leave it out");
}

}  // namespace

Arguments parseArguments(const std::vector<std::string>& words) {
    if (words.empty())
        refuse("nothing to do; give `run`, `tests` or `report FILE`, or see `wifi-profile --help`");
    Arguments arguments;
    const std::string& first = words[0];
    if (first == "run") {
        arguments.command = Command::run;
        if (RunOptionsReader(words).readInto(arguments.run)) {
            arguments.command = Command::runHelp;
        } else {
            refuseConflicts(arguments.run);
        }
        return arguments;
    }
    if (first == "report") return reportArguments(words);
    if (first == "tests") {
        arguments.command = Command::tests;
    } else if (first == "--help" || first == "-h") {
        arguments.command = Command::help;
    } else if (first == "--version") {
        arguments.command = Command::version;
    } else {
        refuse(quoted(first) + " is no command; give `run`, `tests` or `report FILE`, or see `--help`");
    }
    refuseMore(words);
    return arguments;
}

std::string helpText() {
    return "Profiles this device's Wi-Fi: its configuration, the network it is joined to and one more.\n"
           "\n"
           "usage:\n"
           "  wifi-profile run [options]     one run; prints the result as JSON on standard output\n"
           "  wifi-profile tests             the catalogue of tests and what counts as a finding\n"
           "  wifi-profile report FILE       a result (or -) as a report that a person reads\n"
           "  wifi-profile run --help        the options of run\n"
           "  wifi-profile --help, --version\n"
           "\n"
           "exit status: 0 the run is complete; 2 unusable arguments or files; 12 to 17 the run ended\n"
           "with status code -2 to -7; 3 the user left; 129, 130 or 143 interrupted; 1 anything else\n";
}

std::string runHelpText() {
    std::string text = "usage: wifi-profile run [options]\n\noptions:\n";
    for (const Option& option : kOptions) {
        std::string left = std::string("  ") + option.name;
        if (option.takes == Takes::value) left += std::string(" ") + option.placeholder;
        if (option.takes == Takes::optionalValue) left += std::string(" [") + option.placeholder + "]";
        left.resize(std::max<std::size_t>(left.size() + 2, 28), ' ');
        text += left + option.help + "\n";
    }
    return text;
}

}  // namespace wp::host
