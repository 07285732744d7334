#pragma once

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "host/report/evidence.h"

namespace wp::host {

/// One network that the run heard, for pictures of the channels (docs/details.md, test 24).
struct HeardNetwork {
    std::optional<std::string> name;  ///< as it is; absent while hidden
    std::optional<int> signal;        ///< dBm
    int channel = 0;
    std::vector<std::pair<int, int>> spans;  ///< what it occupies, from and to, in MHz
    bool joined = false;
    bool selected = false;
};

enum class HeardBand { ghz2, ghz5, ghz6 };

/// The networks of one band, the strongest first, equal ones by channel and name; an access point that was heard
/// under its name and without it stands once. Empty where the evidence has none. *Any*.
std::vector<HeardNetwork> networksHeard(const Evidence& evidence, HeardBand band);

}  // namespace wp::host
