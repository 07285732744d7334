#pragma once

#include <gtest/gtest.h>
#include <linux/filter.h>
#include <linux/seccomp.h>
#include <sys/prctl.h>
#include <sys/socket.h>
#include <sys/syscall.h>

#include <cerrno>
#include <cstddef>
#include <future>
#include <vector>

namespace wp::fakes {

/// What the function returns on a thread of its own, and on those that it starts, whose system calls go through the
/// filter.
template <class Function>
auto behindFilter(std::vector<sock_filter> steps, Function function) {
    return std::async(std::launch::async,
                      [&] {
                          const sock_fprog program{static_cast<unsigned short>(steps.size()), steps.data()};
                          EXPECT_EQ(0, ::prctl(PR_SET_NO_NEW_PRIVS, 1, 0, 0, 0));
                          EXPECT_EQ(0, ::prctl(PR_SET_SECCOMP, SECCOMP_MODE_FILTER, &program));
                          return function();
                      })
        .get();
}

// clang-format off
/// What it returns where no socket may be bound to an interface, as of a kernel before 5.7 for whoever lacks CAP_NET_RAW.
template <class Function>
auto whereBindingsAreRefused(Function function) {
    constexpr unsigned kLevel = offsetof(seccomp_data, args) + sizeof(__u64), kOption = kLevel + sizeof(__u64);
    return behindFilter({BPF_STMT(BPF_LD | BPF_W | BPF_ABS, offsetof(seccomp_data, nr)),
                         BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, __NR_setsockopt, 0, 5),
                         BPF_STMT(BPF_LD | BPF_W | BPF_ABS, kLevel),
                         BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, SOL_SOCKET, 0, 3),
                         BPF_STMT(BPF_LD | BPF_W | BPF_ABS, kOption),
                         BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, SO_BINDTODEVICE, 0, 1),
                         BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ERRNO | EPERM),
                         BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ALLOW)},
                        function);
}

/// What it returns where the system has no further thread.
template <class Function>
auto whereThreadsAreRefused(Function function) {
    return behindFilter({BPF_STMT(BPF_LD | BPF_W | BPF_ABS, offsetof(seccomp_data, nr)),
                         BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, __NR_clone, 1, 0),
                         BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, __NR_clone3, 0, 1),
                         BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ERRNO | EAGAIN),
                         BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ALLOW)},
                        function);
}
// clang-format on

}  // namespace wp::fakes
