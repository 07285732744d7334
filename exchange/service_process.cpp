#include "exchange/service_process.h"

#include <fcntl.h>
#include <poll.h>
#include <spawn.h>
#include <sys/socket.h>
#include <sys/syscall.h>
#include <sys/wait.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <filesystem>
#include <thread>

#include "exchange/wire.h"

namespace wp {
namespace {

using Clock = std::chrono::steady_clock;
using std::chrono::milliseconds;

/// What the child keeps of this process's descriptors and signals.
class SpawnSettings {
  public:
    explicit SpawnSettings(int childSocket) {
        posix_spawn_file_actions_init(&actions_);
        posix_spawn_file_actions_adddup2(&actions_, childSocket, kWireDescriptor);
        posix_spawn_file_actions_addopen(&actions_, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
        posix_spawn_file_actions_addopen(&actions_, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
        posix_spawn_file_actions_addclosefrom_np(&actions_, kWireDescriptor + 1);
        posix_spawnattr_init(&attributes_);
        sigset_t none;
        sigset_t all;
        sigemptyset(&none);
        sigfillset(&all);
        posix_spawnattr_setsigmask(&attributes_, &none);
        posix_spawnattr_setsigdefault(&attributes_, &all);
        posix_spawnattr_setpgroup(&attributes_, 0);
        posix_spawnattr_setflags(&attributes_,
                                 POSIX_SPAWN_SETSIGMASK | POSIX_SPAWN_SETSIGDEF | POSIX_SPAWN_SETPGROUP);
    }
    ~SpawnSettings() {
        posix_spawn_file_actions_destroy(&actions_);
        posix_spawnattr_destroy(&attributes_);
    }
    SpawnSettings(const SpawnSettings&) = delete;
    SpawnSettings& operator=(const SpawnSettings&) = delete;

    const posix_spawn_file_actions_t* actions() const { return &actions_; }
    const posix_spawnattr_t* attributes() const { return &attributes_; }

  private:
    posix_spawn_file_actions_t actions_{};
    posix_spawnattr_t attributes_{};
};

milliseconds leftUntil(Clock::time_point until) {
    return std::max(std::chrono::ceil<milliseconds>(until - Clock::now()), milliseconds(0));
}

/// Whether there is something to read, or nothing more will come.
bool waitForInput(int socket, Clock::time_point until) {
    pollfd input{socket, POLLIN, 0};
    int ready = 0;
    do ready = ::poll(&input, 1, static_cast<int>(leftUntil(until).count()));
    while (ready < 0 && errno == EINTR);
    return ready > 0;
}

std::string describeEnd(int status) {
    if (WIFSIGNALED(status)) {
        int signal = WTERMSIG(status);
        const char* name = ::sigdescr_np(signal);
        const char* const why = signal == SIGSYS ? ": its sandbox forbids what it was about to do" : "";
        return "signal " + std::to_string(signal) + (name ? std::string(", ") + name : "") + why;
    }
    return "exit status " + std::to_string(WEXITSTATUS(status));
}

}  // namespace

std::string besideProgram(const std::string& name) {
    std::error_code error;
    std::filesystem::path program = std::filesystem::read_symlink("/proc/self/exe", error);
    return error ? name : (program.parent_path() / name).string();
}

std::variant<ServiceProcess, Refusal> ServiceProcess::start(const std::string& path,
                                                            const std::vector<std::string>& arguments) {
    std::array<int, 2> ends{};
    if (::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, ends.data()) != 0)
        return Refusal{path, std::string("no socket for it: ") + std::strerror(errno)};
    Descriptor ours(ends[0]);
    Descriptor theirs(ends[1]);
    ::fcntl(ours.number(), F_SETFL, O_NONBLOCK);
    std::vector<std::string> texts{path};
    texts.insert(texts.end(), arguments.begin(), arguments.end());
    std::vector<char*> words;
    for (std::string& text : texts) words.push_back(text.data());
    words.push_back(nullptr);
    SpawnSettings settings(theirs.number());
    pid_t process = -1;
    int error = ::posix_spawn(&process, path.c_str(), settings.actions(), settings.attributes(), words.data(),
                              environ);
    if (error != 0) return Refusal{path, std::string("cannot be started: ") + std::strerror(error)};
    return ServiceProcess(process, std::move(ours));
}

ServiceProcess::ServiceProcess(ServiceProcess&& other) noexcept
    : process_(std::exchange(other.process_, -1)),
      socket_(std::move(other.socket_)),
      howEnded_(std::move(other.howEnded_)) {}

ServiceProcess::~ServiceProcess() {
    end(milliseconds(0));
}

bool ServiceProcess::reap() {
    if (process_ < 0) return true;
    int status = 0;
    pid_t got = ::waitpid(process_, &status, WNOHANG);
    if (got == 0 || (got < 0 && errno == EINTR)) return false;
    howEnded_ = got == process_ ? describeEnd(status) : "unknown status";
    process_ = -1;
    return true;
}

std::optional<std::string> ServiceProcess::firstLine(Duration patience) {
    const auto until = Clock::now() + patience;
    std::array<char, 4096> buffer;
    std::string line;
    while (line.size() <= kLongestLine && waitForInput(socket(), until)) {
        const ssize_t seen = ::recv(socket(), buffer.data(), buffer.size(), MSG_PEEK);
        if (seen <= 0) return std::nullopt;
        const std::string_view part(buffer.data(), static_cast<std::size_t>(seen));
        const std::size_t end = part.find('\n');
        line += part.substr(0, end);
        // What was looked at is taken out, up to the end of the line alone.
        ::recv(socket(), buffer.data(), std::min(part.size(), end + (end == part.npos ? 0 : 1)), 0);
        if (end != part.npos) return line;
    }
    return std::nullopt;
}

std::optional<std::string> ServiceProcess::waitForEnd(Duration patience) {
    auto until = Clock::now() + patience;
    Descriptor watch(static_cast<int>(::syscall(SYS_pidfd_open, process_, 0)));
    while (!reap()) {
        auto left = leftUntil(until);
        if (left.count() == 0) return std::nullopt;
        if (watch) {
            pollfd ended{watch.number(), POLLIN, 0};
            ::poll(&ended, 1, static_cast<int>(left.count()));
        } else {
            std::this_thread::sleep_for(std::min(left, milliseconds(5)));  // a kernel without pidfd
        }
    }
    return howEnded_;
}

void ServiceProcess::end(Duration patience) {
    socket_.close();
    if (waitForEnd(patience)) return;
    ::kill(process_, SIGKILL);
    constexpr milliseconds untilKilled(2000);  // only a process that may not be killed outlives it
    waitForEnd(untilKilled);
}

}  // namespace wp
