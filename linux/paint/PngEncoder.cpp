#include "linux/paint/PngEncoder.h"

#include <libdeflate.h>

#include <QtEndian>
#include <array>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <vector>

namespace ktr::linux_ {

namespace {

constexpr std::size_t kMostBytes = std::size_t{256} << 20U;
/// Beyond this level of libdeflate's, time grows faster than pictures of text shrink.
constexpr int kLevel = 2;

enum Filter : unsigned char { kNone = 0, kSub = 1, kUp = 2, kPaeth = 4 };

void append(QByteArray& file, const char (&type)[5], const unsigned char* data, std::size_t size) {
    std::array<char, 4> number{};
    qToBigEndian(static_cast<quint32>(size), number.data());
    file.append(number.data(), 4);
    file.append(type, 4);
    file.append(reinterpret_cast<const char*>(data), static_cast<qsizetype>(size));
    quint32 sum = libdeflate_crc32(0, type, 4);
    // An empty chunk has no data to go on with.
    sum = size == 0 ? sum : libdeflate_crc32(sum, data, size);
    qToBigEndian(sum, number.data());
    file.append(number.data(), 4);
}

bool isOpaque(const QImage& picture) {
    for (int y = 0; y < picture.height(); ++y) {
        const auto* row = reinterpret_cast<const QRgb*>(picture.constScanLine(y));
        quint32 all = 0xFF000000U;
        for (int x = 0; x < picture.width(); ++x) {
            all &= row[x];
        }
        if (all >> 24U != 0xFFU) {
            return false;
        }
    }
    return true;
}

unsigned char paeth(int left, int above, int corner) {
    const int p = left + above - corner;
    const int toLeft = std::abs(p - left);
    const int toAbove = std::abs(p - above);
    const int toCorner = std::abs(p - corner);
    return static_cast<unsigned char>(toLeft <= toAbove && toLeft <= toCorner ? left
                                      : toAbove <= toCorner                   ? above
                                                                              : corner);
}

/// Filters rows of pixels of `step` bytes into PNG's scan lines.
class Rows {
  public:
    Rows(std::size_t bytes, std::size_t step) : step_(step), above_(bytes, 0), tried_(bytes, 0) {}

    /// Writes one filter byte and the row.
    void write(const std::vector<unsigned char>& row, unsigned char* line) {
        line[0] = kNone;
        std::memcpy(line + 1, row.data(), row.size());
        if (!isPlain(row)) {
            std::uint64_t best = ~std::uint64_t{0};
            for (const Filter filter : {kSub, kUp, kPaeth}) {
                if (const std::uint64_t sum = apply(filter, row); sum < best) {
                    best = sum;
                    line[0] = filter;
                    std::memcpy(line + 1, tried_.data(), tried_.size());
                }
            }
        }
        above_ = row;
    }

  private:
    /// Whether most pixels are like the one before them.
    bool isPlain(const std::vector<unsigned char>& row) const {
        std::size_t same = 0;
        for (std::size_t i = step_; i < row.size(); i += step_) {
            same += std::memcmp(&row[i], &row[i - step_], step_) == 0 ? 1 : 0;
        }
        return 2 * same * step_ >= row.size() - step_;
    }

    /// The sum of the differences' sizes, which says how well they will compress.
    std::uint64_t apply(Filter filter, const std::vector<unsigned char>& row) {
        std::uint64_t sum = 0;
        for (std::size_t i = 0; i < row.size(); ++i) {
            const unsigned char left = i < step_ ? 0 : row[i - step_];
            const unsigned char corner = i < step_ ? 0 : above_[i - step_];
            const unsigned char guess = filter == kSub  ? left
                                        : filter == kUp ? above_[i]
                                                        : paeth(left, above_[i], corner);
            tried_[i] = static_cast<unsigned char>(row[i] - guess);
            sum += static_cast<unsigned>(std::abs(static_cast<int>(static_cast<signed char>(tried_[i]))));
        }
        return sum;
    }

    std::size_t step_;
    std::vector<unsigned char> above_;
    std::vector<unsigned char> tried_;
};

std::vector<unsigned char> scanLines(const QImage& picture, bool opaque) {
    const std::size_t step = opaque ? 3 : 4;
    const auto width = static_cast<std::size_t>(picture.width());
    std::vector<unsigned char> lines((width * step + 1) * static_cast<std::size_t>(picture.height()));
    std::vector<unsigned char> row(width * step);
    Rows rows(row.size(), step);
    for (int y = 0; y < picture.height(); ++y) {
        const auto* pixels = reinterpret_cast<const QRgb*>(picture.constScanLine(y));
        unsigned char* out = row.data();
        for (std::size_t x = 0; x < width; ++x, out += step) {
            const QRgb pixel = pixels[x];
            out[0] = static_cast<unsigned char>(qRed(pixel));
            out[1] = static_cast<unsigned char>(qGreen(pixel));
            out[2] = static_cast<unsigned char>(qBlue(pixel));
            if (!opaque) {
                out[3] = static_cast<unsigned char>(qAlpha(pixel));
            }
        }
        rows.write(row, lines.data() + (width * step + 1) * static_cast<std::size_t>(y));
    }
    return lines;
}

}  // namespace

QByteArray encodedAsPng(const QImage& given) {
    if (given.isNull() ||
        static_cast<std::size_t>(given.width()) * static_cast<std::size_t>(given.height()) * 4 > kMostBytes) {
        return {};
    }
    const QImage picture = given.convertToFormat(QImage::Format_ARGB32_Premultiplied);
    const std::unique_ptr<libdeflate_compressor, decltype(&libdeflate_free_compressor)> compressor(
        libdeflate_alloc_compressor(kLevel), &libdeflate_free_compressor);
    if (picture.isNull() || !compressor) {
        return {};
    }
    const bool opaque = isOpaque(picture);
    const std::vector<unsigned char> lines =
        scanLines(opaque ? picture : picture.convertToFormat(QImage::Format_ARGB32), opaque);
    std::vector<unsigned char> packed(libdeflate_zlib_compress_bound(compressor.get(), lines.size()));
    const std::size_t size =
        libdeflate_zlib_compress(compressor.get(), lines.data(), lines.size(), packed.data(), packed.size());
    if (size == 0) {
        return {};
    }
    QByteArray file("\x89PNG\r\n\x1a\n", 8);
    // Width, height, 8 bits a channel, RGB or RGBA, then the only compression, filter set and order that are not odd.
    std::array<unsigned char, 13> header{};
    qToBigEndian(static_cast<quint32>(picture.width()), header.data());
    qToBigEndian(static_cast<quint32>(picture.height()), header.data() + 4);
    header[8] = 8;
    header[9] = opaque ? 2 : 6;
    append(file, "IHDR", header.data(), header.size());
    append(file, "IDAT", packed.data(), size);
    append(file, "IEND", nullptr, 0);
    return file;
}

}  // namespace ktr::linux_
