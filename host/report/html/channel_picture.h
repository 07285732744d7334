#pragma once

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "host/report/html/markup.h"

namespace wp::host {

/// One network of a picture. It is known by its number, its place in the list, which a table below repeats.
struct PicturedNetwork {
    enum class Role { other, joined, selected };

    std::string name;                        ///< as it is to be read
    std::optional<int> signal;               ///< dBm; a network without one is not drawn
    std::vector<std::pair<int, int>> spans;  ///< what it occupies, from and to, in MHz
    Role role = Role::other;
};

/// The channels of one band and who is on them.
struct ChannelPicture {
    enum class Band { ghz2, ghz5, ghz6 };

    Band band = Band::ghz2;
    PictureWords words;
    std::string radar;  ///< what stands over channels that are shared with radar; empty: none are marked
    std::vector<int> radarChannels;
    std::vector<PicturedNetwork> networks;
};

/// Draws the picture as SVG: frequency from left to right, signal from -100 to -20 dBm upwards, each network as a
/// shape of its true width, the joined one thick and hatched, the selected one dashed. It tells networks apart without
/// colour. *Any*.
void drawChannels(const ChannelPicture& picture, Markup& markup);

}  // namespace wp::host
