#pragma once

#include <QImage>

namespace ktr::test {

/// How two pictures differ.
struct PictureComparison {
    bool sameSize = false;
    /// Pixels of which a channel differs by more than the tolerance.
    int differing = 0;
    int largestDifference = 0;
    /// The actual picture, faded, with what differs in red.
    QImage difference;

    /// Small rounding of colours along the edges of letters is no difference: up to 16 of 255 a channel anywhere, and
    /// more than that in at most one pixel of ten thousand.
    bool matches() const;
};

PictureComparison compare(const QImage& expected, const QImage& actual);

}  // namespace ktr::test
