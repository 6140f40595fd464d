#pragma once

#include <QImage>
#include <QSize>
#include <optional>

#include "platform/ui/Image.h"

namespace ktr::linux_ {

/// Reads pictures from data that came from anywhere. Any thread.
class ImageDecoder {
  public:
    /// Data beyond kMostBytes and pictures beyond kMostSide pixels a side are refused.
    static constexpr std::size_t kMostBytes = 16UL * 1024UL * 1024UL;
    static constexpr int kMostSide = 4096;

    struct Picture {
        /// Upright, at most as large as was asked for.
        QImage pixels;
        /// The size that the picture has in its data, upright.
        QSize original;
    };

    /// None when the data is no JPEG, PNG, GIF, BMP or WebP picture that can be read, or one beyond the caps. Pictures
    /// whose longer side exceeds `longest` pixels are scaled down to it while they are read.
    static std::optional<Picture> decode(const platform::Bytes& data, int longest);
};

}  // namespace ktr::linux_
