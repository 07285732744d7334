#pragma once

#include <optional>
#include <vector>

#include "linux/stop_signal.h"
#include "service/facts.h"
#include "service/ip_address.h"

namespace wp {

/// Why no answer from one of these addresses can have arrived over the link: where its reverse path filter is strict, the
/// kernel drops whatever comes over it from where the best route leads over another interface (RFC 3704). Nothing where
/// answers pass, or that cannot be told. Of IPv4 alone; the kernel has none for IPv6. *Any* thread.
std::optional<Error> droppedByFilter(const Link& link, const std::vector<IPAddress>& senders,
                                     const Until& until);

}  // namespace wp
