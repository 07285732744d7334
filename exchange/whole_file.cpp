#include "exchange/whole_file.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <memory>

#include "exchange/descriptor.h"

namespace wp {
namespace {

std::string reason(const char* attempt) {
    return std::string(attempt) + ": " + std::strerror(errno);
}

std::variant<std::string, Refusal> readAll(int descriptor, std::size_t limit) {
    std::string content;
    std::array<char, 65536> buffer{};
    for (;;) {
        ssize_t got = ::read(descriptor, buffer.data(), buffer.size());
        if (got == 0) return content;
        if (got < 0 && errno == EINTR) continue;
        if (got < 0) return Refusal{"", reason("cannot be read")};
        content.append(buffer.data(), static_cast<std::size_t>(got));
        if (content.size() > limit) return Refusal{"", "longer than " + std::to_string(limit) + " bytes"};
    }
}

bool writeAll(int descriptor, std::string_view text) {
    while (!text.empty()) {
        ssize_t written = ::write(descriptor, text.data(), text.size());
        if (written < 0 && errno == EINTR) continue;
        if (written < 0) return false;
        text.remove_prefix(static_cast<std::size_t>(written));
    }
    return true;
}

/// The file that the path names behind its symbolic links, as far as there is one.
std::string resolved(const std::string& path) {
    std::unique_ptr<char, decltype(&std::free)> real(::realpath(path.c_str(), nullptr), &std::free);
    return real ? real.get() : path;
}

std::optional<Refusal> writeDirectly(const std::string& path, std::string_view text) {
    Descriptor file(::open(path.c_str(), O_WRONLY | O_CLOEXEC | O_NOCTTY));
    if (!file) return Refusal{"", reason("cannot be opened")};
    if (!writeAll(file.number(), text)) return Refusal{"", reason("cannot be written")};
    return std::nullopt;
}

std::optional<Refusal> replaceFile(const std::string& path, std::string_view text, mode_t permissions) {
    std::string beside = path + ".XXXXXX";
    Descriptor file(::mkostemp(beside.data(), O_CLOEXEC));
    if (!file) return Refusal{"", reason("cannot be created")};
    bool isWritten = writeAll(file.number(), text) && ::fchmod(file.number(), permissions) == 0 &&
                     ::fsync(file.number()) == 0 && file.close() &&
                     ::rename(beside.c_str(), path.c_str()) == 0;
    if (isWritten) return std::nullopt;
    Refusal refusal{"", reason("cannot be written")};
    ::unlink(beside.c_str());
    return refusal;
}

}  // namespace

std::variant<std::string, Refusal> readWholeFile(const std::string& path, std::size_t limit) {
    if (path == "-") return readAll(STDIN_FILENO, limit);
    Descriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NOCTTY));
    if (!file) return Refusal{"", reason("cannot be opened")};
    return readAll(file.number(), limit);
}

std::optional<Refusal> writeWholeFile(const std::string& path, std::string_view text, mode_t permissions) {
    std::string target = resolved(path);
    struct stat status {};
    bool isSpecial = ::stat(target.c_str(), &status) == 0 && !S_ISREG(status.st_mode);
    return isSpecial ? writeDirectly(target, text) : replaceFile(target, text, permissions);
}

}  // namespace wp
