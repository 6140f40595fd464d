#include "linux/paint/PngEncoder.h"

#include <gtest/gtest.h>

#include <QBuffer>
#include <QImageWriter>
#include <QPainter>
#include <algorithm>
#include <random>
#include <vector>

namespace ktr::test {

namespace {

using linux_::PngEncoder;

bool isOpaque(const QImage& picture) {
    for (int y = 0; picture.hasAlphaChannel() && y < picture.height(); ++y) {
        const auto* row = reinterpret_cast<const QRgb*>(picture.constScanLine(y));
        if (std::any_of(row, row + picture.width(), [](QRgb pixel) { return qAlpha(pixel) != 0xFF; })) {
            return false;
        }
    }
    return true;
}

/// A whole picture as a file; empty when it is none.
QByteArray encodedAsPng(const QImage& given) {
    const QImage picture = given.convertToFormat(QImage::Format_ARGB32_Premultiplied);
    PngEncoder encoder(picture.width(), picture.height(), isOpaque(picture));
    encoder.add(picture, picture.height());
    return encoder.file();
}

QImage painted(QColor background) {
    QImage image(320, 200, QImage::Format_ARGB32_Premultiplied);
    image.fill(background);
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setBrush(QColor(200, 30, 90, 128));
    painter.drawEllipse(QRectF(20.5, 30.25, 140.0, 90.0));
    painter.drawText(QPointF(30, 150), QStringLiteral("Fish Market"));
    return image;
}

/// Soft hills with noise, as a photograph or a map has them.
QImage photograph() {
    std::mt19937 random(7);
    QImage image(200, 150, QImage::Format_RGB32);
    for (int y = 0; y < image.height(); ++y) {
        for (int x = 0; x < image.width(); ++x) {
            const auto noise = static_cast<int>(random() % 3);
            image.setPixel(x, y, qRgb((x + noise) % 256, (y + x / 2 + noise) % 256, (2 * y + noise) % 256));
        }
    }
    return image;
}

qsizetype sizeByQt(const QImage& image) {
    QBuffer buffer;
    buffer.open(QIODevice::WriteOnly);
    QImageWriter(&buffer, "png").write(image);
    return buffer.size();
}

QImage decoded(const QByteArray& file) {
    return QImage::fromData(file, "PNG").convertToFormat(QImage::Format_ARGB32_Premultiplied);
}

}  // namespace

TEST(PngEncoderTest, OpaquePicture_ComesBackAsItWas) {
    const QImage image = painted(Qt::white);
    const QByteArray file = encodedAsPng(image);
    EXPECT_EQ(decoded(file), image);
    EXPECT_FALSE(QImage::fromData(file, "PNG").hasAlphaChannel());
}

TEST(PngEncoderTest, TransparentPicture_ComesBackAsQtWouldWriteIt) {
    const QImage image = painted(QColor(10, 20, 30, 0));
    const QImage back = QImage::fromData(encodedAsPng(image), "PNG");
    EXPECT_TRUE(back.hasAlphaChannel());
    EXPECT_EQ(back.convertToFormat(QImage::Format_ARGB32), image.convertToFormat(QImage::Format_ARGB32));
}

TEST(PngEncoderTest, Photograph_ComesBackAsItWas_AndIsNoLargerThanItsPixels) {
    const QImage image = photograph();
    const QByteArray file = encodedAsPng(image);
    EXPECT_EQ(decoded(file), image.convertToFormat(QImage::Format_ARGB32_Premultiplied));
    // What is drawn is mostly plain; a photograph would be smaller with filtered rows.
    EXPECT_LE(file.size(), image.width() * image.height() * 3);
}

TEST(PngEncoderTest, RowsThatCome_InAnyPieces_AreTheSameFile) {
    const QImage image = painted(Qt::white);
    PngEncoder encoder(image.width(), image.height(), true);
    const std::vector<int> cuts = {0, 1, 65, 130, image.height()};
    for (std::size_t i = 1; i < cuts.size(); ++i) {
        EXPECT_TRUE(encoder.file().isEmpty()) << "before row " << cuts[i];
        encoder.add(image.copy(0, cuts[i - 1], image.width(), 150), cuts[i] - cuts[i - 1]);
    }
    EXPECT_EQ(encoder.file(), encodedAsPng(image));
}

TEST(PngEncoderTest, RowsOfAnotherWidth_AreNoFile) {
    const QImage image = painted(Qt::white);
    PngEncoder encoder(image.width() + 1, image.height(), true);
    encoder.add(image, image.height());
    EXPECT_TRUE(encoder.file().isEmpty());
}

TEST(PngEncoderTest, FewerRowsThanSaid_AreNoFile) {
    const QImage image = painted(Qt::white);
    PngEncoder encoder(image.width(), image.height() + 1, true);
    encoder.add(image, image.height() + 1);
    EXPECT_TRUE(encoder.file().isEmpty());
}

TEST(PngEncoderTest, DrawnPicture_IsNotMuchLargerThanQtsFile) {
    const QImage image = painted(Qt::white);
    EXPECT_LE(static_cast<double>(encodedAsPng(image).size()), 1.5 * static_cast<double>(sizeByQt(image)));
}

TEST(PngEncoderTest, OnePixel_IsAPicture) {
    QImage image(1, 1, QImage::Format_RGB32);
    image.fill(Qt::red);
    EXPECT_EQ(decoded(encodedAsPng(image)).pixelColor(0, 0), QColor(Qt::red));
}

TEST(PngEncoderTest, SamePicture_IsTheSameFile) {
    EXPECT_EQ(encodedAsPng(photograph()), encodedAsPng(photograph()));
}

TEST(PngEncoderTest, NoPicture_IsNoFile) {
    EXPECT_TRUE(encodedAsPng(QImage()).isEmpty());
}

}  // namespace ktr::test
