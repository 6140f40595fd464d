#pragma once

#include <QBuffer>
#include <QImage>
#include <QImageWriter>
#include <QRandomGenerator>

#include "platform/ui/Image.h"

namespace ktr::test {

/// A picture as a file of this format has it.
inline platform::Bytes encoded(const QImage& image, const char* format, bool isProgressive = false) {
    QByteArray data;
    QBuffer buffer(&data);
    buffer.open(QIODevice::WriteOnly);
    QImageWriter writer(&buffer, format);
    writer.setProgressiveScanWrite(isProgressive);
    writer.write(image);
    return {data.begin(), data.end()};
}

/// A picture that packs badly, the same every time.
inline QImage noise(int width, int height) {
    QImage image(width, height, QImage::Format_RGB32);
    QRandomGenerator random(7);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            image.setPixel(x, y, random.generate());
        }
    }
    return image;
}

}  // namespace ktr::test
