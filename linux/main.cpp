#include <sys/socket.h>

#include <cstdio>
#include <cstring>
#include <optional>
#include <string>
#include <string_view>

#include "linux/privileges.h"
#include "linux/session.h"

namespace {

constexpr const char* kUsage =
    "usage: wifi-profile-service [--interface NAME]\n"
    "\n"
    "Answers the questions of wifi-profile about the Wi-Fi of this machine. It is started by wifi-profile, "
    "with a\n"
    "connected socket as descriptor 3.\n"
    "\n"
    "  --interface NAME  the Wi-Fi interface to look at\n"
    "  --help            this text\n"
    "  --version         the version\n";

constexpr int kUnusable = 2;

struct Options {
    std::optional<std::string> interfaceName;
};

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
        } else {
            const char* const what = argument == "--interface" ? "needs a name" : "is not an option";
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
    const std::variant<Options, int> read = readOptions(count, arguments);
    if (const int* status = std::get_if<int>(&read)) return *status;
    if (!isSocket(wp::kWireDescriptor)) {
        std::fputs(
            "wifi-profile-service: descriptor 3 is no connected socket; this program is started by "
            "wifi-profile\n",
            stderr);
        return kUnusable;
    }
    wp::Sources sources;
    sources.interfaceName = std::get<Options>(read).interfaceName;
    wp::PowerSwitch power;
    const wp::Privileges privileges = wp::dropPrivileges();

    wp::LineSocket wire{wp::Descriptor(wp::kWireDescriptor)};
    wp::Session session(wire, sources, power);
    if (!privileges.scan) {
        session.note(
            "no permission to scan (CAP_NET_ADMIN): what is not joined can be judged only by what the system "
            "itself has scanned lately");
    }
    session.run();
    return 0;
}
