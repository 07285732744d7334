#pragma once

#include <QImage>
#include <string>

namespace wp::tv {

/// How far apart two pictures are, for a viewer.
struct PictureDifference {
    std::string what;  ///< empty: nothing that could be seen
    QImage picture;    ///< the places that differ in red over the expected picture, paled
};

/// Smoothing at an edge may come out a shade apart, a pixel here and there; anything more is told.
PictureDifference compare(const QImage& expected, const QImage& got);

}  // namespace wp::tv
