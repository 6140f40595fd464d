#include "linux/paint/PngEncoder.h"

#include <spng.h>

#include <algorithm>
#include <cstddef>

namespace ktr::linux_ {

namespace {

/// Beyond this level time grows faster than pictures of text shrink.
constexpr int kLevel = 3;
/// Rows that are converted at a time.
constexpr int kRows = 64;

int append(spng_ctx*, void* file, void* bytes, std::size_t size) {
    static_cast<QByteArray*>(file)->append(static_cast<const char*>(bytes), static_cast<qsizetype>(size));
    return 0;
}

}  // namespace

PngEncoder::PngEncoder(int width, int height, bool opaque)
    : width_(width), opaque_(opaque), context_(spng_ctx_new(SPNG_CTX_ENCODER), spng_ctx_free) {
    spng_ihdr header{};
    header.width = static_cast<std::uint32_t>(std::max(0, width));
    header.height = static_cast<std::uint32_t>(std::max(0, height));
    header.bit_depth = 8;
    header.color_type = opaque ? SPNG_COLOR_TYPE_TRUECOLOR : SPNG_COLOR_TYPE_TRUECOLOR_ALPHA;
    spng_ctx* const context = context_.get();
    failed_ = context == nullptr || spng_set_png_stream(context, append, &file_) != 0 ||
              spng_set_option(context, SPNG_IMG_COMPRESSION_LEVEL, kLevel) != 0 ||
              spng_set_option(context, SPNG_FILTER_CHOICE, SPNG_DISABLE_FILTERING) != 0 ||
              spng_set_ihdr(context, &header) != 0 ||
              spng_encode_image(context, nullptr, 0, SPNG_FMT_PNG, SPNG_ENCODE_PROGRESSIVE | SPNG_ENCODE_FINALIZE) != 0;
}

PngEncoder::~PngEncoder() = default;

void PngEncoder::add(const QImage& picture, int count) {
    const auto format = opaque_ ? QImage::Format_RGB888 : QImage::Format_RGBA8888;
    const auto bytes = static_cast<std::size_t>(width_) * (opaque_ ? 3U : 4U);
    failed_ = failed_ || picture.width() != width_ || picture.height() < count;
    for (int top = 0; !failed_ && top < count; top += kRows) {
        const QImage rows = QImage(picture.constScanLine(top), width_, std::min(kRows, count - top),
                                   picture.bytesPerLine(), picture.format())
                                .convertToFormat(format);
        failed_ = rows.isNull();
        for (int y = 0; !failed_ && y < rows.height(); ++y) {
            const int told = spng_encode_scanline(context_.get(), rows.constScanLine(y), bytes);
            finished_ = told == SPNG_EOI;
            failed_ = told != 0 && !finished_;
        }
    }
}

QByteArray PngEncoder::file() {
    return finished_ && !failed_ ? file_ : QByteArray();
}

}  // namespace ktr::linux_
