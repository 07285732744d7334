#pragma once

#include <cstdint>
#include <vector>

#include "service/access_point.h"

namespace wp {

/// The channel that an access point works on, of its whole operating width.
struct ChannelUse {
    unsigned width = 20;                 ///< MHz; 160 for two halves of 80 MHz that lie apart
    std::vector<std::uint32_t> centres;  ///< MHz; two for such halves
};

/// By what its HT, VHT, HE (on 6 GHz) and EHT operation elements say, the widest first; without them 20 MHz
/// around its primary channel. *Any* thread.
ChannelUse channelUseOf(const AccessPoint& accessPoint);

/// Frequencies in MHz.
struct Span {
    std::uint32_t low = 0;
    std::uint32_t high = 0;
    friend bool operator==(const Span&, const Span&) = default;
};

/// The frequencies that an access point occupies: its operating width counts, not only its primary channel. An
/// 80+80 MHz network has two spans. *Any* thread.
std::vector<Span> occupiedBy(const AccessPoint& accessPoint);

}  // namespace wp
