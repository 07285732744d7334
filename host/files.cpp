#include "host/files.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

#include "host/exit.h"
#include "host/modules/module_entry.h"

namespace wp::host {
namespace {

/// No request, configuration or recording comes near; a device or an endless pipe is refused in time.
constexpr std::size_t kLargestFile = std::size_t{64} << 20;

class Descriptor {
  public:
    explicit Descriptor(const std::string& path)
        : isOwn_(path != "-"), number_(isOwn_ ? open(path.c_str(), O_RDONLY | O_CLOEXEC) : STDIN_FILENO) {}
    ~Descriptor() {
        if (isOwn_ && number_ >= 0) close(number_);
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;
    int number() const { return number_; }

  private:
    bool isOwn_;
    int number_;
};

}  // namespace

void occupyStandardDescriptors() {
    for (int descriptor = 0; descriptor <= 2; ++descriptor) {
        if (fcntl(descriptor, F_GETFD) >= 0) continue;
        // The lowest free number is taken, and it is this one. Deliberately opened the wrong way round: a
        // result that is written to a closed standard output must fail.
        int opened = open("/dev/null", descriptor == STDIN_FILENO ? O_WRONLY : O_RDONLY);
        if (opened != descriptor) return;
    }
}

std::string readFile(const std::string& option, const std::string& path) {
    std::string place = option + ": " + (path == "-" ? "standard input" : path) + ": ";
    Descriptor file(path);
    if (file.number() < 0) refuse(place + "cannot be read: " + std::strerror(errno));
    std::string text;
    char buffer[1 << 16];
    for (;;) {
        ssize_t count = read(file.number(), buffer, sizeof buffer);
        if (count < 0 && errno == EINTR) continue;
        if (count < 0) refuse(place + "cannot be read: " + std::strerror(errno));
        if (count == 0) return text;
        text.append(buffer, static_cast<std::size_t>(count));
        if (text.size() > kLargestFile) refuse(place + "larger than 64 MiB");
    }
}

std::filesystem::path installedResource(const std::filesystem::path& name) {
    return (programFolder() / "../../share/wifi-profile" / name).lexically_normal();
}

std::optional<std::filesystem::path> resourceFile(const std::filesystem::path& name) {
    const std::filesystem::path program = programFolder();
    for (const std::filesystem::path& file :
         {program / "resources" / name, program / "../resources" / name, installedResource(name)}) {
        std::error_code error;
        if (std::filesystem::is_regular_file(file, error)) return file.lexically_normal();
    }
    return std::nullopt;
}

}  // namespace wp::host
