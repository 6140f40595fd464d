#pragma once

#include <QImage>
#include <QSize>
#include <chrono>
#include <optional>

#include "linux/paint/PictureData.h"
#include "platform/ui/Image.h"

namespace ktr::linux_ {

/// The one place where a picture is decoded, whatever it is for: faces, map tiles, named images. Any thread.
///
/// The policy, for data that came from anywhere:
/// - PNG and JPEG alone. Other formats run for long, refer to what is outside of them, or are seldom looked after.
/// - 16 MiB of data; 8192 pixels a side; 2^24 pixels in all, half as many with 16 bits a channel; 64 scans.
///   PictureData holds these before anything is decoded, and keeps all else that the data announces from the decoder.
/// - Two seconds of the thread's computing time; then the picture is given up. Not of the clock's: a busy machine
///   loses no faces.
/// - Together these bound the memory of one decoding to 256 MiB, whatever the data says.
/// Drawings (SVG) are no pictures here: SvgImage reads only those that come with the program.
class ImageDecoder {
  public:
    static constexpr std::chrono::milliseconds kMostTime{2000};

    struct Picture {
        /// Upright, at most as large as was asked for.
        QImage pixels;
        /// The size that the picture has in its data, upright.
        QSize original;
    };

    /// None when the policy refuses the data, or it is damaged. Pictures whose longer side exceeds `longest` pixels are
    /// scaled down to it while they are read. At most `time` of computing time; what is not done by then is none.
    static std::optional<Picture> decode(const platform::Bytes& data, int longest,
                                         std::chrono::nanoseconds time = kMostTime);
};

}  // namespace ktr::linux_
