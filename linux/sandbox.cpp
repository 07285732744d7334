#include "linux/sandbox.h"

#ifdef WP_NO_SANDBOX

namespace wp {

Sandbox enterSandbox() {
    return Sandbox::notInThisBuild;
}

}  // namespace wp

#else

#include <fcntl.h>
#include <linux/sockios.h>
#include <sched.h>
#include <seccomp.h>
#include <sys/ioctl.h>
#include <sys/mman.h>
#include <sys/prctl.h>
#include <sys/socket.h>

#include <cerrno>
#include <memory>
#include <sstream>
#include <string>
#include <utility>

namespace wp {
namespace {

struct Release {
    void operator()(scmp_filter_ctx filter) const { seccomp_release(filter); }
};
using Filter = std::unique_ptr<void, Release>;

// Calls that are harmless whatever they are given. An architecture has some of them only; 32-bit ones have a form
// of their own for several.
constexpr const char* kAllowed[] = {
    // memory
    "brk madvise mremap munmap",
    // threads, signals of one's own, the end
    "exit exit_group futex futex_time64 get_robust_list getpid gettid membarrier restart_syscall rseq",
    "rt_sigaction rt_sigprocmask rt_sigreturn sched_getaffinity sched_yield set_robust_list",
    "set_tid_address sigaltstack sigreturn tgkill",
    // time and waiting
    "_newselect clock_getres clock_getres_time64 clock_gettime clock_gettime64 clock_nanosleep",
    "clock_nanosleep_time64 epoll_create1 epoll_ctl epoll_pwait epoll_wait eventfd2 gettimeofday",
    "nanosleep poll ppoll ppoll_time64 pselect6 pselect6_time64 select time",
    // files that are open, and what lies where
    "_llseek access close dup dup3 faccessat faccessat2 fcntl fcntl64 fstat fstat64 fstatat64 fstatfs",
    "fstatfs64 getcwd getdents getdents64 lseek lstat lstat64 newfstatat pipe2 pread64 read readlink",
    "readlinkat readv stat stat64 statfs statfs64 statx write writev",
    // sockets
    "bind connect getpeername getsockname getsockopt recv recvfrom recvmmsg recvmmsg_time64 recvmsg",
    "send sendmmsg sendmsg sendto setsockopt shutdown socketpair",
    // who and where one is
    "capget getcpu getegid getegid32 geteuid geteuid32 getgid getgid32 getrandom getresgid getresgid32",
    "getresuid getresuid32 getrlimit getrusage getuid getuid32 prlimit64 sysinfo ugetrlimit uname",
};

// What nobody does by mistake: whoever tries has taken the process over. It ends at once.
constexpr const char* kDeadly[] = {
    // other programs and processes
    "execve execveat fork vfork kill tkill ptrace process_vm_readv process_vm_writev pidfd_getfd pidfd_open",
    "pidfd_send_signal kcmp rt_sigqueueinfo rt_tgsigqueueinfo",
    // who one is
    "capset setuid setuid32 setgid setgid32 setreuid setreuid32 setregid setregid32 setresuid setresuid32",
    "setresgid setresgid32 setgroups setgroups32 setfsuid setfsuid32 setfsgid setfsgid32 unshare setns",
    // the file system
    "chmod chown chown32 chroot fchmod fchmodat fchown fchown32 fchownat ftruncate ftruncate64",
    "lchown lchown32 link linkat mkdir mkdirat mknod mknodat mount move_mount open_by_handle_at pivot_root",
    "rename renameat renameat2 rmdir setxattr lsetxattr fsetxattr symlink symlinkat truncate truncate64",
    "umount umount2 unlink unlinkat",
    // the machine
    "add_key bpf delete_module finit_module init_module iopl ioperm kexec_file_load kexec_load keyctl",
    "perf_event_open reboot request_key settimeofday clock_settime clock_settime64 adjtimex clock_adjtime",
    "swapoff swapon userfaultfd",
    // serving others
    "accept accept4 listen",
};

constexpr int kFamilies[] = {AF_UNIX, AF_INET, AF_INET6, AF_NETLINK};
// Questions about an interface, and what stream libraries ask of a descriptor.
constexpr unsigned long kQuestions[] = {SIOCGIFFLAGS, SIOCGIFINDEX, SIOCGIFNAME, SIOCGIFADDR,
                                        FIONREAD,     FIONBIO,      TCGETS};
#ifdef __s390x__
constexpr unsigned kCloneFlags = 1;
#else
constexpr unsigned kCloneFlags = 0;
#endif

/// Adds rules; a call that this architecture does not have needs none.
class Rules {
  public:
    explicit Rules(scmp_filter_ctx filter) : filter_(filter) {}

    template <class... Compared>
    void add(std::uint32_t action, const char* name, Compared... compared) {
        const int number = seccomp_syscall_resolve_name(name);
        if (number == __NR_SCMP_ERROR) return;
        if (seccomp_rule_add(filter_, action, number, sizeof...(compared), compared...) != 0) well_ = false;
    }
    /// The same for calls whose names stand with blanks between them.
    void addAll(std::uint32_t action, const std::string& names) {
        std::istringstream words(names);
        for (std::string name; words >> name;) add(action, name.c_str());
    }
    /// Allows the call where these bits of the argument are clear.
    void allowWithout(const char* name, unsigned argument, scmp_datum_t bits) {
        add(SCMP_ACT_ALLOW, name, SCMP_CMP(argument, SCMP_CMP_MASKED_EQ, bits, 0));
    }
    bool well() const { return well_; }

  private:
    scmp_filter_ctx filter_;
    bool well_ = true;
};

void addMemory(Rules& rules) {
    // Whoever cannot load code has to do without: libraries look for plug-ins now and then.
    for (const char* name : {"mmap", "mmap2", "mprotect"}) {
        rules.allowWithout(name, 2, PROT_EXEC);
        rules.add(SCMP_ACT_ERRNO(EACCES), name, SCMP_CMP(2, SCMP_CMP_MASKED_EQ, PROT_EXEC, PROT_EXEC));
    }
}

void addThreads(Rules& rules) {
    rules.add(SCMP_ACT_ALLOW, "clone", SCMP_CMP(kCloneFlags, SCMP_CMP_MASKED_EQ, CLONE_THREAD, CLONE_THREAD));
    rules.add(SCMP_ACT_KILL_PROCESS, "clone", SCMP_CMP(kCloneFlags, SCMP_CMP_MASKED_EQ, CLONE_THREAD, 0));
    for (const int naming : {PR_SET_NAME, PR_GET_NAME})
        rules.add(SCMP_ACT_ALLOW, "prctl", SCMP_CMP(0, SCMP_CMP_EQ, static_cast<scmp_datum_t>(naming)));
}

void addFiles(Rules& rules) {
    // Whoever cannot write has to do without: a library may keep a log because the environment asks for one.
    constexpr scmp_datum_t kWriting[] = {O_WRONLY, O_RDWR, O_CREAT, O_TRUNC};
    for (const auto& [name, flags] : {std::pair("openat", 2U), std::pair("open", 1U)}) {
        rules.allowWithout(name, flags, O_ACCMODE | O_CREAT | O_TRUNC);
        for (const scmp_datum_t bits : kWriting)
            rules.add(SCMP_ACT_ERRNO(EACCES), name, SCMP_CMP(flags, SCMP_CMP_MASKED_EQ, bits, bits));
    }
}

void addSockets(Rules& rules) {
    for (const int family : kFamilies)
        rules.add(SCMP_ACT_ALLOW, "socket", SCMP_CMP(0, SCMP_CMP_EQ, static_cast<scmp_datum_t>(family)));
    rules.add(SCMP_ACT_KILL_PROCESS, "socket", SCMP_CMP(0, SCMP_CMP_EQ, AF_PACKET));
    for (const unsigned long question : kQuestions)
        rules.add(SCMP_ACT_ALLOW, "ioctl", SCMP_CMP(1, SCMP_CMP_EQ, question));
}

}  // namespace

Sandbox enterSandbox() {
    // As if the kernel were too old for the call: that is what libraries are prepared for. It is also how a thread
    // comes to be started by the older call, whose flags can be looked at.
    const Filter filter(seccomp_init(SCMP_ACT_ERRNO(ENOSYS)));
    if (!filter) return Sandbox::notInThisKernel;
    Rules rules(filter.get());
    for (const char* names : kAllowed) rules.addAll(SCMP_ACT_ALLOW, names);
    for (const char* names : kDeadly) rules.addAll(SCMP_ACT_KILL_PROCESS, names);
    addMemory(rules);
    addThreads(rules);
    addFiles(rules);
    addSockets(rules);
    // A filter with a hole is none.
    if (!rules.well() || seccomp_load(filter.get()) != 0) return Sandbox::notInThisKernel;
    return Sandbox::on;
}

}  // namespace wp

#endif
