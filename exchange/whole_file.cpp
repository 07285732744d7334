#include "exchange/whole_file.h"

#include <fcntl.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstring>

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

}  // namespace

std::variant<std::string, Refusal> readWholeFile(const std::string& path, std::size_t limit) {
    if (path == "-") return readAll(STDIN_FILENO, limit);
    Descriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NOCTTY));
    if (!file) return Refusal{"", reason("cannot be opened")};
    return readAll(file.number(), limit);
}

}  // namespace wp
