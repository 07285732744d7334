#include <unistd.h>

#include <csignal>
#include <exception>
#include <string>
#include <system_error>
#include <vector>

#include "host/arguments.h"
#include "host/diagnostics_log.h"
#include "host/exit.h"
#include "host/files.h"
#include "host/output_file.h"
#include "host/report_command.h"
#include "host/run.h"

namespace wp::host {
namespace {

int print(const std::string& text) {
    if (std::optional<std::string> error = writeAll(STDOUT_FILENO, text))
        fail("standard output: cannot be written: " + *error);
    return exit_status::ok;
}

int perform(const Arguments& arguments) {
    switch (arguments.command) {
        case Command::run:
            return runDiagnostic(arguments.run);
        case Command::tests:
            return print(catalogueOf(arguments.report));
        case Command::report:
            return writeReport(arguments.report);
        case Command::help:
            return print(helpText());
        case Command::runHelp:
            return print(runHelpText());
        case Command::reportHelp:
            return print(reportHelpText());
        case Command::testsHelp:
            return print(testsHelpText());
        case Command::version:
            break;
    }
    return print("wifi-profile " WP_VERSION "\n");
}

int guarded(const std::vector<std::string>& words) {
    DiagnosticsLog log(STDERR_FILENO, DiagnosticsLog::Progress::hidden);
    try {
        return perform(parseArguments(words));
    } catch (const Exit& exit) {
        log.message(exit.what());
        return exit.status();
    } catch (const std::system_error& error) {
        bool isThread = error.code() == std::errc::resource_unavailable_try_again;
        log.message((isThread ? "cannot go on: the system refuses a thread: " : "cannot go on: ") +
                    std::string(error.what()));
        return exit_status::failure;
    } catch (const std::exception& exception) {
        log.message(std::string("cannot go on: ") + exception.what());
        return exit_status::failure;
    }
}

}  // namespace
}  // namespace wp::host

int main(int argc, char** argv) {
    wp::host::occupyStandardDescriptors();
    // A reader that went away and a file that may not grow are errors of the write, told in one line.
    std::signal(SIGPIPE, SIG_IGN);
    std::signal(SIGXFSZ, SIG_IGN);
    int status = wp::host::guarded({argv + (argc > 0 ? 1 : 0), argv + argc});
    // Left without static destructors: code of the extension stays in use until the very end.
    _exit(status);
}
