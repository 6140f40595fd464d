#include <QCoreApplication>
#include <algorithm>
#include <cstddef>
#include <cstdint>

#include "linux/paint/ImageDecoder.h"
#include "tests/fuzz/Require.h"

// Any bytes as a picture: decoded or refused within the policy, and what is handed to the decoder says the same of
// itself as the whole.

namespace {

using ktr::fuzz::require;
using ktr::linux_::ImageDecoder;
using ktr::linux_::PictureData;

/// Qt looks for its readers of formats through the application.
const QCoreApplication& application() {
    static int count = 1;
    static char name[] = "fuzz-picture";
    static char* arguments[] = {name, nullptr};
    static const QCoreApplication made(count, arguments);
    return made;
}

void silence(QtMsgType, const QMessageLogContext&, const QString&) {}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int* /*count*/, char*** /*arguments*/) {
    application();
    qInstallMessageHandler(&silence);
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    constexpr int kLongest = 64;
    const ktr::platform::Bytes bytes(data, data + size);
    const auto facts = PictureData::of(bytes);
    if (facts) {
        require(facts->width >= 1 && facts->width <= PictureData::kMostSide, "the width is capped");
        require(facts->height >= 1 && facts->height <= PictureData::kMostSide, "the height is capped");
        require(std::int64_t{facts->width} * facts->height <= PictureData::kMostPixels, "pixels are capped");
        require(facts->orientation >= 1 && facts->orientation <= 8, "there are eight ways to hold a camera");
        require(facts->essential.size() <= size, "nothing is added");
        const auto again = PictureData::of(facts->essential);
        require(again && again->width == facts->width && again->height == facts->height &&
                    again->essential == facts->essential,
                "what is essential stays so");
    }
    // Decoding what takes long is not what is searched here.
    if (!facts || std::int64_t{facts->width} * facts->height > 1 << 16) {
        return 0;
    }
    if (const auto picture = ImageDecoder::decode(bytes, kLongest)) {
        require(!picture->pixels.isNull(), "a picture has pixels");
        require(std::max(picture->pixels.width(), picture->pixels.height()) <= kLongest, "it is scaled down");
        require(picture->original == QSize(facts->width, facts->height) ||
                    picture->original == QSize(facts->height, facts->width),
                "it is of its size");
    }
    return 0;
}
