#pragma once

namespace wp {

/// What the program may still do after it has given up the rest.
struct Privileges {
    bool scan = false;  ///< CAP_NET_ADMIN, without which the kernel starts no scan
};

/// Gives up every capability but the one to scan, for good, and the ways to gain any. To be called once all
/// sockets that need more are open, before any other thread starts and before a byte from outside is read.
Privileges dropPrivileges();

}  // namespace wp
