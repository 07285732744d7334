#pragma once

#include <set>
#include <string>

#include "exchange/recording.h"

namespace wp {

/// The recording with every network name and every address replaced, the same one always by the same. *Any*
/// thread.
///
/// Names become "Net 0001" and so on in the order in which they sort, with words behind that keep short (to 8
/// characters), middling (to 16) and long ones apart, and with their ending "_nomap" as it was spelled. Hardware
/// addresses become locally administered ones, public IPv4 addresses ones of 198.18.0.0/15, IPv6 addresses
/// ones of the same kind (link-local, unique local, else 2001:db8::/32). Addresses are found in every text;
/// names in the fields and info values that hold them, in values that equal one, and as words inside info texts, error
/// messages, a `why` of details and the description. Values with a meaning of their own (security, PHY modes, country code,
/// address configuration, a base station's model) stay, and so do interface names, but for the hardware address in
/// those that are made from one. The other names are taken for network names too.
Recording anonymised(const Recording& recording, const std::set<std::string>& otherNames = {});

/// Every network name that the recording mentions outside its texts. *Any* thread.
std::set<std::string> networkNamesIn(const Recording& recording);

}  // namespace wp
