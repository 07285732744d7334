// A stand-in for the diagnostics service, scripted by its arguments: pairs of a text that a request line contains
// and what to do upon such a request. A pair serves any number of requests; the first that fits is taken.
//
//   answer:{…}    answers with the object and the request's number
//   send:LINE     sends the line as it stands
//   part:TEXT     sends the text without a newline
//   flood         sends 'x' for ever, without a newline
//   hang          does nothing
//   deaf          reads nothing any more
//   exit:N        ends with this status
//   crash         is killed by a signal
//   forbidden     is killed as its sandbox would do it
//   close         closes the connection and lives on
//
// "start" in place of a request's text is done before the first request is read. The environment's
// WP_SERVICE_LOG names a file to which every request line is appended.

#include <fcntl.h>
#include <signal.h>
#include <unistd.h>

#include <cstdlib>
#include <fstream>
#include <string>
#include <string_view>
#include <vector>

namespace {

constexpr int kSocket = 3;

void writeAll(std::string_view text) {
    while (!text.empty()) {
        ssize_t written = ::write(kSocket, text.data(), text.size());
        if (written <= 0) ::_exit(9);
        text.remove_prefix(static_cast<std::size_t>(written));
    }
}

/// The request's number, as digits; empty where it has none.
std::string numberOf(std::string_view line) {
    std::size_t begin = line.find("\"id\":");
    if (begin == std::string_view::npos) return {};
    begin += 5;
    return std::string(line.substr(begin, line.find_first_not_of("0123456789", begin) - begin));
}

[[noreturn]] void sleepForEver() {
    for (;;) ::pause();
}

void perform(const std::string& action, std::string_view line) {
    auto rest = [&](std::string_view prefix) { return action.substr(prefix.size()); };
    if (action.starts_with("answer:{")) {
        std::string body = rest("answer:{");
        writeAll("{\"id\":" + numberOf(line) + (body == "}" ? "" : ",") + body + "\n");
    } else if (action.starts_with("send:")) {
        writeAll(rest("send:") + "\n");
    } else if (action.starts_with("part:")) {
        writeAll(rest("part:"));
    } else if (action == "flood") {
        for (std::string much(65536, 'x');;) writeAll(much);
    } else if (action == "deaf") {
        sleepForEver();
    } else if (action.starts_with("exit:")) {
        ::_exit(std::atoi(rest("exit:").c_str()));
    } else if (action == "forbidden") {
        ::raise(SIGSYS);
    } else if (action == "crash") {
        ::raise(SIGKILL);
    } else if (action == "close") {
        ::close(kSocket);
        sleepForEver();
    } else if (action != "hang") {
        ::_exit(8);
    }
}

void serve(const std::vector<std::string>& script, const std::string& line) {
    for (std::size_t i = 0; i + 1 < script.size(); i += 2)
        if (line.find(script[i]) != std::string::npos) return perform(script[i + 1], line);
}

}  // namespace

int main(int argc, char** argv) {
    std::vector<std::string> script(argv + 1, argv + argc);
    const char* log = std::getenv("WP_SERVICE_LOG");
    for (std::size_t i = 0; i + 1 < script.size(); i += 2)
        if (script[i] == "start") perform(script[i + 1], "");
    std::string incoming;
    char buffer[4096];
    for (;;) {
        ssize_t got = ::read(kSocket, buffer, sizeof buffer);
        if (got <= 0) return 0;
        incoming.append(buffer, static_cast<std::size_t>(got));
        for (std::size_t end = 0; (end = incoming.find('\n')) != std::string::npos;) {
            std::string line = incoming.substr(0, end);
            incoming.erase(0, end + 1);
            if (log) std::ofstream(log, std::ios::app) << line << "\n";
            serve(script, line);
        }
    }
}
