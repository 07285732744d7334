#pragma once

#include <chrono>
#include <optional>
#include <string>
#include <vector>

namespace wp::host {

enum class ScreenChoice { automatic, tv, terminal, headless, none };
enum class OutputFormat { json, text, html };
enum class Command { run, tests, report, help, runHelp, reportHelp, testsHelp, version };

/// The options of `wifi-profile run` as they were given; what they mean together is decided where they are
/// used.
struct RunOptions {
    std::optional<std::string> requestFile;      ///< "-" is standard input
    std::optional<std::string> maxScanCacheAge;  ///< a JSON number's text
    bool list = false;
    std::optional<std::string> network;
    std::optional<std::string> replayFile;
    std::optional<std::string> demo;  ///< the name of a recording that ships with the program
    std::optional<std::string> recordFile;
    bool anonymise = false;
    std::optional<std::string> interfaceName;
    std::optional<std::chrono::milliseconds> timeout;
    std::optional<std::string> configFile;
    bool showEndpoints = false;
    bool noClosingPage = false;
    ScreenChoice screen = ScreenChoice::automatic;
    std::optional<std::string> remote;
    std::optional<std::string> transcriptFile;  ///< "-" is standard output
    std::optional<std::string> automationFile;
    std::optional<std::string> locale;
    std::optional<std::string> outputFile;
    OutputFormat format = OutputFormat::json;
    std::optional<std::string> extension;
};

/// The options of `wifi-profile report`; those of `tests` are among them.
struct ReportOptions {
    std::string file;  ///< a result or a recording; "-" is standard input
    OutputFormat format = OutputFormat::text;
    bool all = false;                        ///< every test, not findings alone
    std::optional<std::string> compareFile;  ///< of an earlier run, a result or a recording
    std::optional<std::string> locale;
    std::optional<std::string> configFile;
    std::optional<std::string> outputFile;
    std::optional<std::string> extension;
};

struct Arguments {
    Command command = Command::help;
    RunOptions run;
    ReportOptions report;
};

/// Reads the command line (without the program's own name). Throws `Exit` with status 2 and a line that names
/// the argument. *Main*.
Arguments parseArguments(const std::vector<std::string>& words);

/// The texts of `--help` and of each command's.
std::string helpText();
std::string runHelpText();
std::string reportHelpText();
std::string testsHelpText();

}  // namespace wp::host
