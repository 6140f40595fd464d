#include "linux/paint/PictureData.h"

#include <cstring>
#include <string_view>
#include <utility>

namespace ktr::linux_ {

namespace {

using platform::Bytes;
// NOLINTNEXTLINE(misc-unused-using-decls): every "..."sv below uses it.
using std::string_view_literals::operator""sv;

std::uint32_t big(const Bytes& data, std::size_t at, std::size_t bytes) {
    std::uint32_t value = 0;
    for (std::size_t i = 0; i < bytes; ++i) {
        value = value << 8 | data[at + i];
    }
    return value;
}

std::uint32_t little(const Bytes& data, std::size_t at, std::size_t bytes) {
    std::uint32_t value = 0;
    for (std::size_t i = bytes; i > 0; --i) {
        value = value << 8 | data[at + i - 1];
    }
    return value;
}

bool begins(const Bytes& data, std::size_t at, std::string_view text) {
    return data.size() - at >= text.size() && std::memcmp(data.data() + at, text.data(), text.size()) == 0;
}

void append(Bytes& to, const Bytes& from, std::size_t at, std::size_t length) {
    to.insert(to.end(), from.begin() + static_cast<std::ptrdiff_t>(at),
              from.begin() + static_cast<std::ptrdiff_t>(at + length));
}

/// Takes the size over if it is within the caps.
bool setSize(PictureData& picture, std::uint32_t width, std::uint32_t height, int bitsAChannel) {
    const std::int64_t w = width;
    const std::int64_t h = height;
    if (w < 1 || h < 1 || w > PictureData::kMostSide || h > PictureData::kMostSide ||
        w * h * (bitsAChannel > 8 ? 2 : 1) > PictureData::kMostPixels) {
        return false;
    }
    picture.width = static_cast<int>(w);
    picture.height = static_cast<int>(h);
    return true;
}

constexpr std::string_view kPngSignature = "\x89PNG\r\n\x1a\n";
constexpr std::size_t kChunkFrame = 12;  // length, name, checksum
constexpr std::uint32_t kHeaderLength = 13;

/// Chunk by chunk: header, palette and transparency before the pixels, the end.
std::optional<PictureData> png(const Bytes& data) {
    PictureData picture;
    picture.format = PictureData::Format::Png;
    append(picture.essential, data, 0, kPngSignature.size());
    bool hasPixels = false;
    for (std::size_t at = kPngSignature.size(); data.size() - at >= kChunkFrame;) {
        const std::size_t length = big(data, at, 4);
        if (length > data.size() - at - kChunkFrame) {
            return std::nullopt;
        }
        const bool isFirst = at == kPngSignature.size();
        const bool isHeader = begins(data, at + 4, "IHDR");
        if (isFirst != isHeader) {
            return std::nullopt;
        }
        if (isHeader && (length != kHeaderLength ||
                         !setSize(picture, big(data, at + 8, 4), big(data, at + 12, 4), data[at + 16]))) {
            return std::nullopt;
        }
        const bool isPixels = begins(data, at + 4, "IDAT");
        const bool isEnd = begins(data, at + 4, "IEND");
        const bool isColours = begins(data, at + 4, "PLTE") || begins(data, at + 4, "tRNS");
        hasPixels = hasPixels || isPixels;
        if (isHeader || isPixels || isEnd || (isColours && !hasPixels)) {
            append(picture.essential, data, at, length + kChunkFrame);
        }
        if (isEnd) {
            return hasPixels ? std::optional(std::move(picture)) : std::nullopt;
        }
        at += length + kChunkFrame;
    }
    return std::nullopt;
}

/// The orientation among the first directory's entries of a TIFF file that stands at `begin`.
int orientationIn(const Bytes& data, std::size_t begin, std::size_t end) {
    constexpr std::size_t kEntry = 12;
    const std::size_t length = end - begin;
    if (length < 8 || (!begins(data, begin, "II*\0"sv) && !begins(data, begin, "MM\0*"sv))) {
        return 1;
    }
    const auto number = data[begin] == 'I' ? &little : &big;
    const std::size_t directory = number(data, begin + 4, 4);
    if (directory > length - 2) {
        return 1;
    }
    std::size_t at = begin + directory + 2;
    for (std::size_t left = number(data, at - 2, 2); left > 0 && end - at >= kEntry; --left, at += kEntry) {
        constexpr std::uint32_t kOrientation = 0x0112;
        if (number(data, at, 2) == kOrientation) {
            const std::uint32_t value = number(data, at + 8, 2);
            return value >= 1 && value <= 8 ? static_cast<int>(value) : 1;
        }
    }
    return 1;
}

/// Marker by marker; between a start of scan and the next marker stand coded pixels.
class JpegWalk {
  public:
    explicit JpegWalk(const Bytes& data) : data_(data) {}

    std::optional<PictureData> walk() {
        picture_.format = PictureData::Format::Jpeg;
        append(picture_.essential, data_, 0, 2);
        at_ = 2;
        while (const auto marker = nextMarker()) {
            if (*marker == kEnd) {
                append(picture_.essential, data_, at_ - 2, 2);
                return scans_ > 0 ? std::optional(std::move(picture_)) : std::nullopt;
            }
            if (!segment(*marker)) {
                return std::nullopt;
            }
        }
        return std::nullopt;
    }

  private:
    static constexpr unsigned kEnd = 0xD9;
    static constexpr unsigned kScan = 0xDA;

    /// The code of the marker that begins here, and steps behind it; none when there is none.
    std::optional<unsigned> nextMarker() {
        if (at_ >= data_.size() || data_[at_] != 0xFF) {
            return std::nullopt;
        }
        while (at_ < data_.size() && data_[at_] == 0xFF) {
            ++at_;
        }
        return at_ < data_.size() ? std::optional<unsigned>(data_[at_++]) : std::nullopt;
    }

    bool segment(unsigned marker) {
        const std::size_t length = data_.size() - at_ >= 2 ? big(data_, at_, 2) : 0;
        if (length < 2 || length > data_.size() - at_) {
            return false;
        }
        const bool isFrame = marker >= 0xC0 && marker <= 0xCF && marker != 0xC4 && marker != 0xC8 && marker != 0xCC;
        if (isFrame && !frame(marker, length)) {
            return false;
        }
        constexpr std::size_t kExif = 8;
        if (marker == 0xE1 && length > kExif && begins(data_, at_ + 2, "Exif\0\0"sv) && picture_.orientation == 1) {
            picture_.orientation = orientationIn(data_, at_ + kExif, at_ + length);
        }
        if (isFrame || isKept(marker, length)) {
            picture_.essential.push_back(0xFF);
            picture_.essential.push_back(static_cast<std::uint8_t>(marker));
            append(picture_.essential, data_, at_, length);
        }
        at_ += length;
        return marker != kScan || scan();
    }

    /// Baseline, extended and progressive frames (SOF0 to SOF2), once.
    bool frame(unsigned marker, std::size_t length) {
        constexpr std::size_t kLeast = 8;
        return picture_.width == 0 && marker <= 0xC2 && length >= kLeast && data_[at_ + 2] == 8 &&
               setSize(picture_, big(data_, at_ + 5, 2), big(data_, at_ + 3, 2), 8);
    }

    /// Tables and scans, and how colours are meant (JFIF's APP0 and Adobe's APP14).
    bool isKept(unsigned marker, std::size_t length) {
        const auto names = [&](std::string_view text) {
            return length >= text.size() + 2 && begins(data_, at_ + 2, text);
        };
        switch (marker) {
            case 0xC4:  // Huffman tables
            case 0xDB:  // quantization tables
            case 0xDD:  // restart interval
            case kScan:
                return true;
            case 0xE0:
                return names("JFIF\0"sv);
            case 0xEE:
                return names("Adobe");
            default:
                return false;
        }
    }

    /// Over the coded pixels to the next marker that is neither a stuffed byte nor a restart.
    bool scan() {
        if (picture_.width == 0 || ++scans_ > PictureData::kMostScans) {
            return false;
        }
        const std::size_t begin = at_;
        while (true) {
            const auto* found = static_cast<const std::uint8_t*>(
                at_ < data_.size() ? std::memchr(data_.data() + at_, 0xFF, data_.size() - at_) : nullptr);
            if (!found || found + 1 == data_.data() + data_.size()) {
                return false;
            }
            at_ = static_cast<std::size_t>(found - data_.data());
            const unsigned next = found[1];
            const bool isRestart = next >= 0xD0 && next <= 0xD7;
            if (next != 0 && next != 0xFF && !isRestart) {
                break;
            }
            at_ += next == 0xFF ? 1 : 2;
        }
        append(picture_.essential, data_, begin, at_ - begin);
        return true;
    }

    const Bytes& data_;
    PictureData picture_;
    std::size_t at_ = 0;
    int scans_ = 0;
};

}  // namespace

std::optional<PictureData> PictureData::of(const Bytes& data) {
    if (data.size() > kMostBytes) {
        return std::nullopt;
    }
    if (begins(data, 0, kPngSignature)) {
        return png(data);
    }
    if (begins(data, 0, "\xFF\xD8\xFF")) {
        return JpegWalk(data).walk();
    }
    return std::nullopt;
}

}  // namespace ktr::linux_
