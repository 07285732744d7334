#pragma once

#include <string_view>
#include <vector>

#include "service/ip_address.h"

namespace wp {

/// The addresses of a list that blanks or commas part. The length of a prefix may follow each ("10.0.0.7/24") and is dropped;
/// what is no address is passed over. *Any* thread.
std::vector<IPAddress> addressesIn(std::string_view list);

}  // namespace wp
