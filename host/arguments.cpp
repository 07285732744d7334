#include "host/arguments.h"

#include <charconv>
#include <cmath>
#include <set>
#include <span>

#include "host/exit.h"

namespace wp::host {
namespace {

enum class Takes { nothing, value, optionalValue };

template <class Options>
struct Option {
    const char* name;
    Takes takes;
    const char* placeholder;
    void (*apply)(Options&, const std::string& value);
    const char* help;
};

/// A run ends in minutes; a day leaves room and keeps every sum of moments far from overflow.
constexpr double kLongestTimeoutSeconds = 86400;

std::string quoted(const std::string& text) {
    return '"' + text + '"';
}

std::string demoFrom(const std::string& text) {
    return text.empty() ? "home" : text;
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

OutputFormat reportFormatFrom(const std::string& text) {
    if (text == "text") return OutputFormat::text;
    if (text == "html") return OutputFormat::html;
    refuse("--format: " + quoted(text) + " is no format of a report; give text or html");
}

std::string asGiven(const std::string& text) {
    return text;
}

/// What becomes of a row's value: the member takes it as a function reads it.
template <auto member, auto read = asGiven>
constexpr auto into = [](auto& options, const std::string& value) { options.*member = read(value); };

template <auto member>
constexpr auto on = [](auto& options, const std::string&) { options.*member = true; };

// clang-format off
const Option<RunOptions> kRunOptions[] = {
    {"--request",            Takes::value,         "FILE",    into<&RunOptions::requestFile>,
     "the request's parameters as a JSON object (-: standard input)"},
    {"--max-scan-cache-age", Takes::value,         "N",       into<&RunOptions::maxScanCacheAge>,
     "accept scans up to N seconds old, 0 to 600 (default 60)"},
    {"--list",               Takes::nothing,       "",        on<&RunOptions::list>,
     "show the list of networks and let the user choose"},
    {"--network",            Takes::value,         "NAME",    into<&RunOptions::network>,
     "profile this network beside the joined one"},
    {"--replay",             Takes::value,         "FILE",    into<&RunOptions::replayFile>,
     "take all answers from a recording instead of this machine"},
    {"--demo",               Takes::optionalValue, "NAME",    into<&RunOptions::demo, demoFrom>,
     "replay a recording that ships with the program (default home)"},
    {"--record",             Takes::value,         "FILE",    into<&RunOptions::recordFile>,
     "write what platform and service answered as a recording"},
    {"--anonymise",          Takes::nothing,       "",        on<&RunOptions::anonymise>,
     "replace names and addresses in the recording consistently"},
    {"--interface",          Takes::value,         "NAME",    into<&RunOptions::interfaceName>,
     "the Wi-Fi interface to look at, where there are several"},
    {"--timeout",            Takes::value,         "SECONDS", into<&RunOptions::timeout, timeoutFrom>,
     "end the run after that long at the latest"},
    {"--config",             Takes::value,         "FILE",    into<&RunOptions::configFile>,
     "endpoints, vendors, thresholds and capabilities (JSON)"},
    {"--show-endpoints",     Takes::nothing,       "",        on<&RunOptions::showEndpoints>,
     "print what a live run would contact, and end"},
    {"--screen",             Takes::value,         "SCREEN",  into<&RunOptions::screen, screenFrom>,
     "tv, terminal, headless, none or auto (default)"},
    {"--no-closing-page",    Takes::nothing,       "",        on<&RunOptions::noClosingPage>,
     "end at once instead of showing the outcome on the screen"},
    {"--remote",             Takes::value,         "SCRIPT",  into<&RunOptions::remote>,
     "remote-control keys to press (@FILE: from a file)"},
    {"--transcript",         Takes::value,         "FILE",    into<&RunOptions::transcriptFile>,
     "the snapshots that the script asks for (-: standard output)"},
    {"--automation",         Takes::value,         "FILE",    into<&RunOptions::automationFile>,
     "enable test automation; what is posted to it is written there"},
    {"--locale",             Takes::value,         "NAME",    into<&RunOptions::locale>,
     "language of the screen: en, de, ja or x-keys"},
    {"--output",             Takes::value,         "FILE",    into<&RunOptions::outputFile>,
     "write the result there instead of to standard output"},
    {"--format",             Takes::value,         "FORMAT",  into<&RunOptions::format, formatFrom>,
     "json (default) or text"},
    {"--extension",          Takes::value,         "PATH",    into<&RunOptions::extension>,
     "the diagnostic's module, where it is not beside the program"},
};

const Option<ReportOptions> kReportOptions[] = {
    {"--format",             Takes::value,         "FORMAT",  into<&ReportOptions::format, reportFormatFrom>,
     "text (default) or html, one page on its own"},
    {"--all",                Takes::nothing,       "",        on<&ReportOptions::all>,
     "every test, not only the findings"},
    {"--compare",            Takes::value,         "OLD",     into<&ReportOptions::compareFile>,
     "what changed since this earlier result or recording (or -)"},
    {"--locale",             Takes::value,         "NAME",    into<&ReportOptions::locale>,
     "language of the report: en, de, ja or x-keys"},
    {"--config",             Takes::value,         "FILE",    into<&ReportOptions::configFile>,
     "the thresholds that the run went by (JSON)"},
    {"--output",             Takes::value,         "FILE",    into<&ReportOptions::outputFile>,
     "write the report there instead of to standard output"},
    {"--extension",          Takes::value,         "PATH",    into<&ReportOptions::extension>,
     "the diagnostic's module, where it is not beside the program"},
};

const Option<ReportOptions> kTestsOptions[] = {
    {"--locale",             Takes::value,         "NAME",    into<&ReportOptions::locale>,
     "language of the catalogue: en, de, ja or x-keys"},
    {"--config",             Takes::value,         "FILE",    into<&ReportOptions::configFile>,
     "thresholds other than the program's own (JSON)"},
};
// clang-format on

/// Walks through the words after a command.
template <class Options>
class OptionsReader {
  public:
    /// \param file where a word that is no option goes; null: there is none
    OptionsReader(const std::vector<std::string>& words, std::span<const Option<Options>> known,
                  std::string* file = nullptr)
        : words_(words), command_(words[0]), known_(known), file_(file) {}

    /// Returns whether help was asked for.
    bool readInto(Options& options) {
        while (next_ < words_.size()) {
            if (words_[next_] == "--help" || words_[next_] == "-h") return true;
            if (words_[next_] == "--") {
                while (++next_ < words_.size()) takeFile(words_[next_]);
                return false;
            }
            readOne(options);
        }
        return false;
    }

    /// The names of the options that were given.
    const std::set<std::string>& seen() const { return seen_; }

  private:
    void readOne(Options& options) {
        std::string word = words_[next_++];
        if (word.rfind("--", 0) != 0) return takeFile(word);
        std::optional<std::string> value;
        if (std::size_t equals = word.find('='); equals != std::string::npos) {
            value = word.substr(equals + 1);
            word.resize(equals);
        }
        const Option<Options>* option = optionNamed(word);
        if (!option)
            refuse(word + ": no such option of " + command_ + "; `wifi-profile " + command_ +
                   " --help` lists them");
        if (!seen_.insert(word).second) refuse(word + ": given twice; give it once");
        option->apply(options, valueOf(*option, std::move(value)));
    }

    void takeFile(const std::string& word) {
        if (!file_)
            refuse(quoted(word) + " is not an option of " + command_ + "; `wifi-profile " + command_ +
                   " --help` lists them");
        if (!file_->empty()) refuse(quoted(word) + ": " + command_ + " takes one file; leave it out");
        if (word.empty()) refuse(command_ + ": the file's name is empty; give FILE (or -)");
        *file_ = word;
    }

    const Option<Options>* optionNamed(const std::string& name) const {
        for (const Option<Options>& option : known_)
            if (name == option.name) return &option;
        return nullptr;
    }

    std::string valueOf(const Option<Options>& option, std::optional<std::string> value) {
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
    const std::string& command_;
    std::span<const Option<Options>> known_;
    std::string* file_;
    std::size_t next_ = 1;
    std::set<std::string> seen_;
};

void refuseWithoutRun(const std::set<std::string>& given) {
    for (const std::string& name : given) {
        if (name == "--show-endpoints" || name == "--config" || name == "--interface") continue;
        refuse(name + ": not together with --show-endpoints, which ends without a run");
    }
}

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
    if (options.requestFile == "-" && options.replayFile == "-")
        refuse("--replay: \"-\" is read already, as --request; give a file for one of the two");
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
    Arguments arguments;
    arguments.command = Command::report;
    ReportOptions& options = arguments.report;
    if (OptionsReader<ReportOptions>(words, kReportOptions, &options.file).readInto(options))
        arguments.command = Command::reportHelp;
    else if (options.file.empty())
        refuse("report: needs a FILE (or -), a result or a recording");
    if (options.file == "-" && options.compareFile == "-")
        refuse("--compare: \"-\" is read already; give a file for one of the two");
    return arguments;
}

Arguments testsArguments(const std::vector<std::string>& words) {
    Arguments arguments;
    arguments.command = Command::tests;
    if (OptionsReader<ReportOptions>(words, kTestsOptions).readInto(arguments.report))
        arguments.command = Command::testsHelp;
    return arguments;
}

template <class Options>
std::string listed(std::span<const Option<Options>> options) {
    std::string text;
    for (const Option<Options>& option : options) {
        std::string left = std::string("  ") + option.name;
        if (option.takes == Takes::value) left += std::string(" ") + option.placeholder;
        if (option.takes == Takes::optionalValue) left += std::string(" [") + option.placeholder + "]";
        left.resize(std::max<std::size_t>(left.size() + 2, 28), ' ');
        text += left + option.help + "\n";
    }
    return text;
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
        OptionsReader<RunOptions> reader(words, kRunOptions);
        if (reader.readInto(arguments.run)) {
            arguments.command = Command::runHelp;
            return arguments;
        }
        if (arguments.run.showEndpoints) refuseWithoutRun(reader.seen());
        refuseConflicts(arguments.run);
        return arguments;
    }
    if (first == "report") return reportArguments(words);
    if (first == "tests") return testsArguments(words);
    if (first == "--help" || first == "-h") {
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
           "  wifi-profile report FILE       a result or a recording (or -) as a report for people\n"
           "  wifi-profile run --help        the options of run; likewise report --help, tests --help\n"
           "  wifi-profile --help, --version\n"
           "\n"
           "exit status: 0 the run is complete; 2 unusable arguments or files; 12 to 17 the run ended\n"
           "with status code -2 to -7; 3 the user left; 129, 130 or 143 interrupted; 1 anything else\n";
}

std::string runHelpText() {
    return "usage: wifi-profile run [options]\n\noptions:\n" + listed<RunOptions>(kRunOptions);
}

std::string reportHelpText() {
    return "usage: wifi-profile report FILE [options]\n\n"
           "FILE is a result or, with more to tell, a recording (-: standard input).\n\noptions:\n" +
           listed<ReportOptions>(kReportOptions);
}

std::string testsHelpText() {
    return "usage: wifi-profile tests [options]\n\noptions:\n" + listed<ReportOptions>(kTestsOptions);
}

}  // namespace wp::host
