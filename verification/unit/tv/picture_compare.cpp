#include "verification/unit/tv/picture_compare.h"

#include <algorithm>
#include <cstdlib>

namespace wp::tv {
namespace {

constexpr int kUnseenShade = 16;  // of 255
constexpr double kUnseenPart = 2e-5;

int distance(QRgb left, QRgb right) {
    return std::max({std::abs(qRed(left) - qRed(right)), std::abs(qGreen(left) - qGreen(right)),
                     std::abs(qBlue(left) - qBlue(right))});
}

}  // namespace

PictureDifference compare(const QImage& expected, const QImage& got) {
    if (expected.isNull()) return {"there is no picture to compare with", got};
    if (expected.size() != got.size()) return {"the size is another", got};
    QImage left = expected.convertToFormat(QImage::Format_RGB32);
    QImage right = got.convertToFormat(QImage::Format_RGB32);
    QImage picture = left;
    long different = 0;
    for (int y = 0; y < left.height(); ++y) {
        for (int x = 0; x < left.width(); ++x) {
            QRgb before = left.pixel(x, y);
            bool isSeen = distance(before, right.pixel(x, y)) > kUnseenShade;
            different += isSeen ? 1 : 0;
            int pale = 160 + qGray(before) * 95 / 255;
            picture.setPixel(x, y, isSeen ? qRgb(220, 0, 0) : qRgb(pale, pale, pale));
        }
    }
    if (different <= kUnseenPart * left.width() * left.height()) return {};
    return {std::to_string(different) + " pixels differ", picture};
}

}  // namespace wp::tv
