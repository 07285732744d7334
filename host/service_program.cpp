#include "host/service_program.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/mman.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>

#include "host/exit.h"
#include "host/extension_module.h"

extern char** environ;

namespace wp::host {
namespace {

constexpr int kCannotStart = 127;

/// A place in memory for what a program prints.
class Collected {
  public:
    Collected() : descriptor_(memfd_create("printed", MFD_CLOEXEC)) {}
    ~Collected() { close(descriptor_); }
    Collected(const Collected&) = delete;
    Collected& operator=(const Collected&) = delete;

    int descriptor() const { return descriptor_; }
    std::string text() const {
        std::string text(static_cast<std::size_t>(std::max<off_t>(lseek(descriptor_, 0, SEEK_END), 0)), '\0');
        ssize_t count = pread(descriptor_, text.data(), text.size(), 0);
        text.resize(static_cast<std::size_t>(std::max<ssize_t>(count, 0)));
        return text;
    }

  private:
    int descriptor_;
};

int exitStatus(pid_t process) {
    int status = 0;
    while (waitpid(process, &status, 0) < 0)
        if (errno != EINTR) return kCannotStart;
    return WIFEXITED(status) ? WEXITSTATUS(status) : exit_status::signalBase + WTERMSIG(status);
}

}  // namespace

std::string serviceProgram() {
    return (programFolder() / kServiceFileName).string();
}

ProgramOutput runProgram(const std::string& path, const std::vector<std::string>& arguments) {
    Collected output;
    Collected error;
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
    posix_spawn_file_actions_adddup2(&actions, output.descriptor(), STDOUT_FILENO);
    posix_spawn_file_actions_adddup2(&actions, error.descriptor(), STDERR_FILENO);
    std::vector<std::string> words = arguments;
    words.insert(words.begin(), path);
    std::vector<char*> argv;
    for (std::string& word : words) argv.push_back(word.data());
    argv.push_back(nullptr);
    pid_t process = 0;
    bool isStarted = posix_spawn(&process, path.c_str(), &actions, nullptr, argv.data(), environ) == 0;
    posix_spawn_file_actions_destroy(&actions);
    ProgramOutput result;
    result.status = isStarted ? exitStatus(process) : kCannotStart;
    result.standardOutput = output.text();
    result.standardError = error.text();
    return result;
}

}  // namespace wp::host
