#include "tests/golden/PictureComparison.h"

#include <algorithm>
#include <cstdlib>

namespace ktr::test {

namespace {

constexpr int kTolerance = 16;
constexpr int kPixelsPerFreeOne = 10000;

int distance(QRgb a, QRgb b) {
    return std::max({std::abs(qRed(a) - qRed(b)), std::abs(qGreen(a) - qGreen(b)), std::abs(qBlue(a) - qBlue(b)),
                     std::abs(qAlpha(a) - qAlpha(b))});
}

QRgb faded(QRgb pixel) {
    const int grey = 192 + qGray(pixel) / 4;
    return qRgb(grey, grey, grey);
}

}  // namespace

bool PictureComparison::matches() const {
    return sameSize && differing <= difference.width() * difference.height() / kPixelsPerFreeOne;
}

PictureComparison compare(const QImage& expectedPicture, const QImage& actualPicture) {
    PictureComparison result;
    const QImage expected = expectedPicture.convertToFormat(QImage::Format_ARGB32);
    const QImage actual = actualPicture.convertToFormat(QImage::Format_ARGB32);
    result.sameSize = expected.size() == actual.size();
    result.difference = actual;
    if (!result.sameSize) {
        return result;
    }
    for (int y = 0; y < actual.height(); ++y) {
        const auto* left = reinterpret_cast<const QRgb*>(expected.constScanLine(y));
        const auto* right = reinterpret_cast<const QRgb*>(actual.constScanLine(y));
        auto* out = reinterpret_cast<QRgb*>(result.difference.scanLine(y));
        for (int x = 0; x < actual.width(); ++x) {
            const int apart = distance(left[x], right[x]);
            result.largestDifference = std::max(result.largestDifference, apart);
            result.differing += apart > kTolerance ? 1 : 0;
            out[x] = apart > kTolerance ? qRgb(224, 0, 32) : faded(right[x]);
        }
    }
    return result;
}

}  // namespace ktr::test
