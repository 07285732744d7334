#pragma once

#include "linux/dbus/bus.h"
#include "linux/stop_signal.h"
#include "service/facts.h"

namespace wp {

/// How an interface is set up that no manager can be asked about: by the kernel's addresses and routes, the leases and
/// processes of DHCP clients, and the files that say how it is to be set up. *Any* thread; blocks like gatherSetup.
Known<LinkSetup> setupWithoutManager(Known<Bus>& bus, const Link& link, const Until& until);

}  // namespace wp
