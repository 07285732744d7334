#pragma once

namespace wp {

/// Gives up every capability but the one to scan (CAP_NET_ADMIN), for good, and the ways to gain any. To be called
/// once all sockets that need more are open, before any other thread starts and before a byte from outside is read.
void dropPrivileges();

}  // namespace wp
