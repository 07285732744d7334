#include "host/transcript.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

#include "host/exit.h"
#include "host/output_file.h"

namespace wp::host {

Transcript::Transcript(Target target) : name_("standard output") {
    if (target == Target::standardOutput) descriptor_ = STDOUT_FILENO;
}

Transcript::Transcript(const std::string& file) : name_(file), isOwn_(true) {
    descriptor_ = open(file.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0666);
    if (descriptor_ < 0) refuse("--transcript: " + file + ": cannot be written: " + std::strerror(errno));
}

Transcript::~Transcript() {
    if (isOwn_) close(descriptor_);
}

void Transcript::add(std::string_view line) {
    if (descriptor_ < 0) return;
    std::optional<std::string> error = writeAll(descriptor_, std::string(line) + "\n");
    if (error) fail("--transcript: " + name_ + ": not written: " + *error);
}

}  // namespace wp::host
