#include <malloc.h>
#include <sys/socket.h>

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <optional>
#include <string>
#include <string_view>

#include "linux/config.h"
#include "linux/files/user_folder.h"
#include "linux/privileges.h"
#include "linux/sandbox.h"
#include "linux/session.h"

namespace {

constexpr const char* kUsage =
    "usage: wifi-profile-service [--interface NAME] [--config FILE]\n"
    "\n"
    "Answers the questions of wifi-profile about the Wi-Fi of this machine. It is started by wifi-profile, "
    "with a\n"
    "connected socket as descriptor 3.\n"
    "\n"
    "  --interface NAME     the Wi-Fi interface to look at\n"
    "  --config FILE        a configuration, over those of the system and the user\n"
    "  --help               this text\n"
    "  --version            the version\n";

constexpr int kUnusable = 2;

struct Options {
    std::optional<std::string> interfaceName;
    std::string config;
};

/// The configuration, or the line that says what is wrong with it.
std::variant<wp::Config, std::string> readConfig(const std::string& named) {
    const std::string user = wp::userConfigFolder([](const char* name) { return std::getenv(name); });
    return wp::loadConfig(wp::configFiles(user), named);
}

/// The options, or an exit status.
std::variant<Options, int> readOptions(int count, char** arguments) {
    Options options;
    for (int i = 1; i < count; ++i) {
        const std::string_view argument = arguments[i];
        if (argument == "--help") {
            std::fputs(kUsage, stdout);
            return 0;
        }
        if (argument == "--version") {
            std::puts("wifi-profile-service " WP_VERSION);
            return 0;
        }
        if (argument == "--interface" && i + 1 < count) {
            options.interfaceName = arguments[++i];
        } else if (argument == "--config" && i + 1 < count) {
            options.config = arguments[++i];
        } else {
            const char* const what = argument == "--interface" ? "needs a name"
                                     : argument == "--config"  ? "needs a file"
                                                               : "is not an option";
            std::fprintf(stderr, "wifi-profile-service: %s %s\n", arguments[i], what);
            return kUnusable;
        }
    }
    return options;
}

bool isSocket(int descriptor) {
    int type = 0;
    socklen_t size = sizeof type;
    return getsockopt(descriptor, SOL_SOCKET, SO_TYPE, &type, &size) == 0 && type == SOCK_STREAM;
}

}  // namespace

int main(int count, char** arguments) {
    // Some twenty threads come and go, and each would begin a heap of its own.
    mallopt(M_ARENA_MAX, 1);
    // What writes to a connection that its other end has left is told so.
    std::signal(SIGPIPE, SIG_IGN);
    const std::variant<Options, int> read = readOptions(count, arguments);
    if (const int* status = std::get_if<int>(&read)) return *status;
    const Options& options = std::get<Options>(read);
    if (!isSocket(wp::kWireDescriptor)) {
        std::fputs(
            "wifi-profile-service: descriptor 3 is no connected socket; this program is started by "
            "wifi-profile\n",
            stderr);
        return kUnusable;
    }
    wp::LineSocket wire{wp::Descriptor(wp::kWireDescriptor)};
    const std::variant<wp::Config, std::string> config = readConfig(options.config);
    if (const std::string* fault = std::get_if<std::string>(&config)) {
        wire.send(wp::greetingLine({nullptr, *fault}));
        return kUnusable;
    }
    wire.send(wp::greetingLine({wp::toldOf(std::get<wp::Config>(config)), ""}));
    wp::Sources sources;
    sources.interfaceName = options.interfaceName;
    sources.config = std::get<wp::Config>(config);
    const char* const trace = std::getenv("WIFI_PROFILE_TRACE");
    sources.traced = trace != nullptr && *trace != '\0';
    wp::PowerSwitch power;
    wp::dropPrivileges();
    const wp::Sandbox sandbox = wp::enterSandbox();

    wp::Session session(wire, sources, power);
    if (sandbox == wp::Sandbox::notInThisKernel)
        session.note("this kernel filters no system calls (seccomp): the service runs without its sandbox");
    session.run();
    return 0;
}
