#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>

#include "platform/ui/Image.h"

namespace ktr::linux_ {

/// What a picture's data says of itself, looked through without decoding anything, and the part of it that a decoder
/// needs to see. A value; any thread; linear in the data's length.
///
/// Only PNG (W3C, second edition) and JPEG (ITU-T T.81: baseline, extended and progressive with eight bits) are known.
/// Each announced length has to lie within the data, and the data has to go on to its end mark: a decoder reserves what
/// is announced before it finds out that it is not there. Everything that says nothing about the pixels (comments,
/// packed texts, colour profiles, previews, animation) is left out of `essential`, and so is never unpacked.
struct PictureData {
    enum class Format { Png, Jpeg };

    /// The caps that hold before anything is decoded.
    static constexpr std::size_t kMostBytes = std::size_t{16} << 20;
    static constexpr std::int64_t kMostSide = 8192;
    /// 16-bit channels count twice.
    static constexpr std::int64_t kMostPixels = std::int64_t{1} << 24;
    /// Each scan of a progressive JPEG goes over the whole picture again; cameras and encoders write ten or so.
    static constexpr int kMostScans = 64;

    Format format = Format::Png;
    int width = 0;   ///< pixels, as stored: not turned by what a camera noted
    int height = 0;  ///< likewise
    /// How the camera was held (Exif 2.32, 4.6.4, tag 0x0112): 1 to 8, 1 is upright.
    int orientation = 1;
    /// The picture without what is not needed.
    platform::Bytes essential;

    /// None for anything else, for what is damaged as far as can be seen without decoding, and beyond the caps.
    static std::optional<PictureData> of(const platform::Bytes& data);
};

}  // namespace ktr::linux_
