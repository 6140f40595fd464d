#include "linux/paint/ImageDecoder.h"

#include <QBuffer>
#include <QByteArray>
#include <QImageReader>
#include <algorithm>

namespace ktr::linux_ {

std::optional<ImageDecoder::Picture> ImageDecoder::decode(const platform::Bytes& data, int longest) {
    if (data.empty() || data.size() > kMostBytes || longest < 1) {
        return std::nullopt;
    }
    QByteArray bytes =
        QByteArray::fromRawData(reinterpret_cast<const char*>(data.data()), static_cast<qsizetype>(data.size()));
    QBuffer buffer(&bytes);
    QImageReader reader(&buffer);
    reader.setDecideFormatFromContent(true);
    reader.setAutoTransform(true);
    // Formats that may refer to something outside of them, or run for long, are left out.
    static const QList<QByteArray> kFormats = {"jpeg", "jpg", "png", "gif", "bmp", "webp"};
    if (!reader.canRead() || !kFormats.contains(reader.format())) {
        return std::nullopt;
    }
    const QSize size = reader.size();
    if (size.isEmpty() || size.width() > kMostSide || size.height() > kMostSide) {
        return std::nullopt;
    }
    if (std::max(size.width(), size.height()) > longest) {
        const QSize scaled = size.scaled(longest, longest, Qt::KeepAspectRatio);
        reader.setScaledSize(scaled.expandedTo(QSize(1, 1)));
    }
    const bool turned = reader.transformation().testFlag(QImageIOHandler::TransformationRotate90);
    Picture picture{reader.read(), turned ? size.transposed() : size};
    if (picture.pixels.isNull()) {
        return std::nullopt;
    }
    return picture;
}

}  // namespace ktr::linux_
