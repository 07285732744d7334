#pragma once

namespace wp {

enum class Sandbox { on, notInThisBuild, notInThisKernel };

/// Confines the process, for good, to the system calls that measuring takes: memory without code in it, threads but
/// no processes, sockets of the internet, of the kernel and of the message bus that nobody can connect to, files
/// opened for reading only. To open one for writing, or to load code, fails (EACCES), because libraries try that in
/// passing. What only somebody does who has taken the process over (start a program, change files or who one is, serve
/// others) kills it at once (SIGSYS), which the host reports. Any other call, and numbers of `ioctl` and `prctl` that
/// are not on the list, fail as if the kernel did not have them (ENOSYS): a later library tries new ones in passing.
/// The lists hold names, so that they serve every architecture.
///
/// To be called after `dropPrivileges`, before any other thread starts and before a byte from outside is read. Builds
/// with a sanitizer or for coverage have no sandbox: their run-time libraries trace, map and write as they please.
Sandbox enterSandbox();

}  // namespace wp
