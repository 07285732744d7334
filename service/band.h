#pragma once

#include <cstdint>

namespace wp {

enum class Band { none, ghz2, ghz5, ghz6 };

/// The band of a frequency in MHz. *Any* thread.
constexpr Band bandOf(std::uint32_t frequency) {
    if (frequency >= 2400 && frequency <= 2500) return Band::ghz2;
    if (frequency >= 4900 && frequency <= 5895) return Band::ghz5;
    if (frequency >= 5925 && frequency <= 7125) return Band::ghz6;
    return Band::none;
}

/// The channel number of a centre frequency in MHz, 0 where there is none. *Any* thread.
constexpr int channelOf(std::uint32_t frequency) {
    const int mhz = static_cast<int>(frequency);
    if (mhz == 2484) return 14;
    if (mhz == 5935) return 2;
    switch (bandOf(frequency)) {
        case Band::ghz2:
            return (mhz - 2407) / 5;
        case Band::ghz5:
            return (mhz - 5000) / 5;
        case Band::ghz6:
            return (mhz - 5950) / 5;
        case Band::none:
            break;
    }
    return 0;
}

}  // namespace wp
