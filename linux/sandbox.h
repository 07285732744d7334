#pragma once

namespace wp {

enum class Sandbox { on, notInThisBuild, notInThisKernel };

/// Confines the process, for good, to the system calls that measuring takes: memory without code in it, threads but
/// no processes, sockets of the internet, of the kernel and of the message bus that nobody can connect to, files
/// opened for reading only. To open one for writing, or to load code, fails (EACCES), because libraries try that in
/// passing. Any other call kills the whole process (SIGSYS), which the host reports. The list holds names, so that
/// it serves every architecture.
///
/// To be called after `dropPrivileges`, before any other thread starts and before a byte from outside is read. Builds
/// with a sanitizer or for coverage have no sandbox: their run-time libraries trace, map and write as they please.
Sandbox enterSandbox();

}  // namespace wp
