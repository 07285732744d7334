#include "linux/sandbox.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <signal.h>
#include <sys/ioctl.h>
#include <sys/mman.h>
#include <sys/mount.h>
#include <sys/prctl.h>
#include <sys/ptrace.h>
#include <sys/socket.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <fstream>
#include <future>

#include "linux/dbus/bus.h"
#include "linux/gather.h"
#include "linux/privileges.h"
#include "linux/probe/name_lookup.h"
#include "linux/probe/web_client.h"
#include "verification/unit/linux/stop.h"

namespace wp {
namespace {

#ifdef WP_NO_SANDBOX

TEST(Sandbox, IsNotInBuildsWhoseRunTimeLibrariesNeedMore) {
    EXPECT_EQ(Sandbox::notInThisBuild, enterSandbox());
}

#else

/// Ends the process with 0 when `work` came to its end inside the sandbox and was content.
template <class Work>
[[noreturn]] void inSandbox(Work work) {
    dropPrivileges();
    if (enterSandbox() != Sandbox::on) _exit(2);
    _exit(work() ? 0 : 1);
}

struct Forbidden {
    const char* name;
    void (*call)();
};

const Forbidden kForbidden[] = {
    {"a program", [] { ::execl("/bin/true", "true", nullptr); }},
    {"a process", [] { (void)::fork(); }},
    {"removing", [] { ::unlink("/no/such/file"); }},
    {"tracing", [] { ::ptrace(PTRACE_ATTACH, getppid(), 0, 0); }},
    {"mounting", [] { ::mount("none", "/no/such/folder", "tmpfs", 0, ""); }},
    {"frames", [] { (void)::socket(AF_PACKET, SOCK_RAW, 0); }},
    {"listening", [] { ::listen(0, 1); }},
    {"others' processes", [] { ::kill(getppid(), 0); }},
    {"another user", [] { (void)::setuid(65534); }},
};

TEST(Sandbox, KillsWhoeverDoesWhatNobodyDoesByMistake) {
    for (const Forbidden& each : kForbidden)
        EXPECT_EXIT(inSandbox([&] { return each.call(), true; }), ::testing::KilledBySignal(SIGSYS), "")
            << each.name;
}

TEST(Sandbox, FailsCallsAndNumbersThatItDoesNotKnow) {
    const auto fails = [](long result) { return result == -1 && errno == ENOSYS; };
    const auto allFail = [&] {
        return fails(::ioctl(0, TIOCGWINSZ, nullptr)) && fails(::prctl(PR_GET_TIMERSLACK, 0, 0, 0, 0)) &&
               fails(::prctl(PR_SET_DUMPABLE, 1, 0, 0, 0)) && fails(::syscall(SYS_getpriority, 0, 0)) &&
               fails(::syscall(100000)) && fails(::socket(AF_BLUETOOTH, SOCK_RAW, 0));
    };
    EXPECT_EXIT(inSandbox(allFail), ::testing::ExitedWithCode(0), "");
}

TEST(Sandbox, LetsNoMemoryHoldCode) {
    const auto mapsCode = [] {
        return ::mmap(nullptr, 4096, PROT_READ | PROT_EXEC, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0) !=
                   MAP_FAILED ||
               errno != EACCES;
    };
    EXPECT_EXIT(inSandbox([&] { return !mapsCode(); }), ::testing::ExitedWithCode(0), "");
}

TEST(Sandbox, OpensFilesForReadingOnly) {
    const auto isRefused = [](const char* file, int flags) {
        return ::open(file, flags, 0600) < 0 && errno == EACCES;
    };
    const auto refusesAll = [&] {
        return isRefused("/dev/null", O_WRONLY) && isRefused("/dev/null", O_RDWR | O_APPEND) &&
               isRefused("/dev/null", O_ACCMODE) && isRefused("/dev/null", O_RDONLY | O_TRUNC) &&
               isRefused("/tmp/wp-sandbox", O_RDONLY | O_CREAT) && ::open("/dev/null", O_RDONLY) >= 0;
    };
    EXPECT_EXIT(inSandbox(refusesAll), ::testing::ExitedWithCode(0), "");
}

TEST(Sandbox, LeavesRoomForEveryKindOfMeasuring) {
    const auto measures = [] {
        WebRequest request;
        request.url = "https://127.0.0.1:1/";
        const auto web =
            std::async(std::launch::async, [&] { return runWebRequests({request}, patience()); });
        web.wait();
        lookUpName("host.example", {{*IPAddress::fromText("127.0.0.1")}, "", 1}, patience());
        Known<Bus> bus = Bus::at("unix:path=/no/such/bus");
        if (bus) bus->property({"a.b", "/"}, "a.b", "C", patience());
        gatherLink(std::nullopt, patience());
        std::string line;
        std::getline(std::ifstream("/proc/self/status"), line);
        return line.starts_with("Name:");
    };
    EXPECT_EXIT(inSandbox(measures), ::testing::ExitedWithCode(0), "");
}

#endif

}  // namespace
}  // namespace wp
