#pragma once

#include <optional>
#include <string_view>
#include <vector>

#include "service/ip_address.h"

namespace wp {

/// The addresses of a list that blanks or commas part. The length of a prefix may follow each ("10.0.0.7/24") and is dropped;
/// what is no address is passed over. *Any* thread.
std::vector<IPAddress> addressesIn(std::string_view list);

/// The address of a name server as resolvers write one: "dns+tls://[2001:db8::53]:853%wlan0#dns.example" with all, or nothing but
/// the address. Nothing where it has none. *Any* thread.
std::optional<IPAddress> serverFrom(std::string_view text);

}  // namespace wp
