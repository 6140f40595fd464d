// After ITU-T T.81, annex B; the colours' marker after TN 5116.
#include "server/ingest/JpegFace.h"

#include <cstdint>

#include "server/ingest/Face.h"

namespace ktr::server {

namespace {

constexpr unsigned kStart = 0xD8, kEnd = 0xD9, kScan = 0xDA, kTables = 0xDB, kCodes = 0xC4, kRestart = 0xDD,
                   kColours = 0xEE;

unsigned byteAt(std::string_view bytes, std::size_t at) {
    return static_cast<unsigned char>(bytes[at]);
}

unsigned wordAt(std::string_view bytes, std::size_t at) {
    return byteAt(bytes, at) << 8U | byteAt(bytes, at + 1);
}

/// Baseline, extended, progressive; what else there is hardly anything draws.
bool isFrame(unsigned marker) {
    return marker >= 0xC0 && marker <= 0xC2;
}

/// What draws nothing: application data, comments.
bool isMetadata(unsigned marker) {
    return (marker >= 0xE0 && marker <= 0xEF) || marker == 0xFE;
}

/// Where the packed data that begins here ends: at the next marker that is no restart.
std::size_t endOfData(std::string_view picture, std::size_t at) {
    for (; at + 1 < picture.size(); ++at) {
        const unsigned next = byteAt(picture, at + 1);
        if (byteAt(picture, at) == 0xFF && next != 0 && next != 0xFF && !(next >= 0xD0 && next <= 0xD7)) {
            return at;
        }
    }
    return picture.size();
}

/// Reads a file part by part and writes anew what is kept.
class Cleaner {
  public:
    explicit Cleaner(std::string_view picture) : picture_(picture) {}

    /// What is wrong; none when all was read.
    std::optional<std::string> run() {
        while (!ended_) {
            // Any number of 0xFF may stand before a marker.
            while (at_ + 1 < picture_.size() && byteAt(picture_, at_) == 0xFF && byteAt(picture_, at_ + 1) == 0xFF) {
                ++at_;
            }
            if (at_ + 1 >= picture_.size() || byteAt(picture_, at_) != 0xFF) {
                return "is a damaged JPEG";
            }
            const unsigned marker = byteAt(picture_, at_ + 1);
            at_ += 2;
            if (marker == kEnd) {
                ended_ = true;
            } else if (const auto problem = takeSegment(marker)) {
                return problem;
            }
        }
        return scans_ == 0 ? std::optional<std::string>("is a damaged JPEG") : std::nullopt;
    }

    std::string written() { return std::move(out_) + "\xFF\xD9"; }

  private:
    std::optional<std::string> takeSegment(unsigned marker) {
        if (picture_.size() - at_ < 2 || wordAt(picture_, at_) < 2 || wordAt(picture_, at_) > picture_.size() - at_) {
            return "is a damaged JPEG";
        }
        const std::string_view segment = picture_.substr(at_, wordAt(picture_, at_));
        at_ += segment.size();
        if (marker == kColours) {
            return takeColours(segment);
        }
        if (isMetadata(marker)) {
            return std::nullopt;
        }
        if (isFrame(marker)) {
            if (const auto problem = problemOfFrame(segment)) {
                return problem;
            }
            framed_ = true;
        } else if (marker == kScan) {
            if (!framed_ || ++scans_ > JpegFace::kMostScans) {
                return "is a damaged JPEG";
            }
        } else if (marker != kTables && marker != kCodes && marker != kRestart) {
            return "is an unusual JPEG: save it as a plain one";
        }
        write(marker, segment);
        if (marker == kScan) {
            const std::size_t end = endOfData(picture_, at_);
            out_ += picture_.substr(at_, end - at_);
            at_ = end;
        }
        return std::nullopt;
    }

    /// Whether three colours are red, green and blue: without it they would be drawn wrong. Written anew, so that
    /// nothing travels in it.
    std::optional<std::string> takeColours(std::string_view segment) {
        if (segment.size() >= 14 && segment.substr(2, 5) == "Adobe" && !coloured_) {
            coloured_ = true;
            using namespace std::string_view_literals;
            out_ +=
                "\xFF\xEE\x00\x0E"
                "Adobe\x00\x64\x00\x00\x00\x00"sv;
            out_ += segment[13] == 0 ? '\0' : '\1';
        }
        return std::nullopt;
    }

    std::optional<std::string> problemOfFrame(std::string_view segment) const {
        if (framed_ || segment.size() < 8) {
            return "is a damaged JPEG";
        }
        const unsigned colours = byteAt(segment, 7);
        if (byteAt(segment, 2) != 8 || (colours != 1 && colours != 3)) {
            return "is an unusual JPEG: save it as a plain one";
        }
        const unsigned height = wordAt(segment, 3);
        const unsigned width = wordAt(segment, 5);
        if (height == 0 || width == 0 || segment.size() != 8 + 3 * colours) {
            return "is a damaged JPEG";
        }
        return height > Face::kMostPixels || width > Face::kMostPixels
                   ? std::optional<std::string>("has more than 512 pixels along a side")
                   : std::nullopt;
    }

    void write(unsigned marker, std::string_view segment) {
        out_ += '\xFF';
        out_ += static_cast<char>(marker);
        out_ += segment;
    }

    std::string_view picture_;
    std::size_t at_ = 2;
    std::string out_ = "\xFF\xD8";
    int scans_ = 0;
    bool framed_ = false;
    bool coloured_ = false;
    bool ended_ = false;
};

}  // namespace

bool JpegFace::is(std::string_view picture) {
    return picture.size() > 2 && byteAt(picture, 0) == 0xFF && byteAt(picture, 1) == kStart &&
           byteAt(picture, 2) == 0xFF;
}

std::optional<std::string> JpegFace::cleaned(std::string_view picture, std::string& complaint) {
    Cleaner cleaner(picture);
    if (const auto problem = cleaner.run()) {
        complaint = *problem;
        return std::nullopt;
    }
    return cleaner.written();
}

}  // namespace ktr::server
