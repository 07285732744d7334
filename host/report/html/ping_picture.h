#pragma once

#include <optional>
#include <string>
#include <vector>

#include "host/report/html/markup.h"

namespace wp::host {

/// The answers to a row of echo requests.
struct PingPicture {
    std::string identifier;                    ///< of the picture in its page
    std::string title;                         ///< for those who cannot see it
    std::string description;                   ///< the same in a sentence or two
    std::vector<std::optional<double>> times;  ///< ms; absent: lost
    std::vector<std::string> labels;           ///< one for each, as it is to be read
};

/// Draws the picture as SVG: a column for each answer, as high as it took, a cross for each that was lost. *Any*.
void drawPings(const PingPicture& picture, Markup& markup);

}  // namespace wp::host
