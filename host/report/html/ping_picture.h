#pragma once

#include <optional>
#include <string>
#include <vector>

#include "host/report/html/markup.h"

namespace wp::host {

/// The answers to a row of echo requests.
struct PingPicture {
    PictureWords words;
    std::vector<std::optional<double>> times;  ///< ms; absent: lost
    std::vector<std::string> labels;           ///< one for each, as it is to be read
};

/// Draws the picture as SVG: a column for each answer, as high as it took, a cross for each that was lost. *Any*.
void drawPings(const PingPicture& picture, Markup& markup);

}  // namespace wp::host
