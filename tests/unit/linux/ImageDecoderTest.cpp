#include "linux/paint/ImageDecoder.h"

#include <gtest/gtest.h>
#include <sys/resource.h>

#include <QColorSpace>
#include <QImageReader>
#include <algorithm>
#include <string_view>

#include "tests/support/qt/Pictures.h"

namespace ktr::linux_ {

using platform::Bytes;
using test::encoded;
using test::noise;
using std::string_view_literals::operator""sv;

namespace {

Bytes operator+(Bytes first, std::string_view second) {
    first.insert(first.end(), second.begin(), second.end());
    return first;
}

Bytes inserted(Bytes data, std::size_t at, std::string_view text) {
    data.insert(data.begin() + static_cast<std::ptrdiff_t>(at), text.begin(), text.end());
    return data;
}

Bytes cut(const Bytes& data, std::size_t size) {
    return {data.begin(), data.begin() + static_cast<std::ptrdiff_t>(size)};
}

std::string bigEndian(std::uint32_t value) {
    return {static_cast<char>(value >> 24), static_cast<char>(value >> 16), static_cast<char>(value >> 8),
            static_cast<char>(value)};
}

/// Its checksum is wrong: only what is left out may stand in it.
std::string chunk(std::string_view name, std::string_view content) {
    return bigEndian(static_cast<std::uint32_t>(content.size())) + std::string(name) + std::string(content) + "none";
}

std::string segment(char marker, std::string_view content) {
    const auto length = static_cast<std::uint32_t>(content.size() + 2);
    return std::string("\xFF") + marker + bigEndian(length).substr(2) + std::string(content);
}

constexpr std::size_t kAfterHeader = 33;  // PNG's signature and first chunk
constexpr std::size_t kAfterStart = 2;    // JPEG's first marker

std::size_t find(const Bytes& data, std::string_view text) {
    const auto found = std::search(data.begin(), data.end(), text.begin(), text.end(),
                                   [](std::uint8_t a, char b) { return a == static_cast<std::uint8_t>(b); });
    return static_cast<std::size_t>(found - data.begin());
}

bool isRead(const Bytes& data) {
    return ImageDecoder::decode(data, 100).has_value();
}

/// The most memory that this process ever had; bytes.
long peak() {
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return usage.ru_maxrss * 1024;
}

/// A picture whose four corners differ, held as an orientation says.
Bytes held(int orientation) {
    QImage image(48, 32, QImage::Format_RGB32);
    image.fill(Qt::white);
    for (int y = 0; y < 16; ++y) {
        for (int x = 0; x < 24; ++x) {
            image.setPixel(x, y, qRgb(255, 0, 0));
            image.setPixel(47 - x, y, qRgb(0, 0, 255));
        }
    }
    std::string exif("Exif\0\0MM\0*\0\0\0\x08\0\x01\x01\x12\0\x03\0\0\0\x01\0"sv);
    exif += static_cast<char>(orientation);
    exif.append("\0\0\0\0\0\0"sv);
    return inserted(encoded(image, "JPG"), kAfterStart, segment('\xE1', exif));
}

}  // namespace

TEST(ImageDecoderTest, LargePictures_AreScaledWhileTheyAreRead) {
    QImage pixels(1000, 500, QImage::Format_RGB32);
    pixels.fill(Qt::red);
    for (const char* format : {"PNG", "JPG"}) {
        const auto picture = ImageDecoder::decode(encoded(pixels, format), 100);
        ASSERT_TRUE(picture) << format;
        EXPECT_EQ(picture->pixels.size(), QSize(100, 50));
        EXPECT_EQ(picture->original, QSize(1000, 500));
    }
    EXPECT_FALSE(ImageDecoder::decode(encoded(pixels, "PNG"), 0));
}

TEST(ImageDecoderTest, OtherFormats_AreRefused) {
    QImage pixels(30, 20, QImage::Format_RGB32);
    pixels.fill(Qt::red);
    for (const char* format : {"BMP", "PPM", "XPM"}) {
        EXPECT_FALSE(isRead(encoded(pixels, format))) << format;
    }
    const std::string_view drawing = R"(<svg xmlns="http://www.w3.org/2000/svg" width="10" height="10"/>)";
    EXPECT_FALSE(isRead(Bytes() + drawing));
    EXPECT_FALSE(isRead(Bytes()));
    EXPECT_FALSE(isRead(Bytes() + "\x89PNG\r\n\x1a\n"));
    EXPECT_FALSE(isRead(Bytes() + "\xFF\xD8\xFF"));
    EXPECT_FALSE(isRead(Bytes() + "\xFF\xD8\xFF\xD9"));
}

TEST(ImageDecoderTest, FiftySevenBytesThatAnnounceAGigabyte_CostNothing) {
    const Bytes whole = encoded(noise(1, 1), "PNG");
    const Bytes bomb =
        cut(whole, kAfterHeader) + bigEndian(1U << 30) + "iCCP" + std::string(57 - kAfterHeader - 8, 'x');
    ASSERT_EQ(bomb.size(), 57U);
    const long before = peak();
    EXPECT_FALSE(isRead(bomb));
    EXPECT_LT(peak() - before, 64L << 20);
}

TEST(ImageDecoderTest, JpegOfTwentyThousandASide_CostsNothing) {
    Bytes large = encoded(noise(16, 16), "JPG");
    const std::size_t frame = find(large, "\xFF\xC0"sv);
    for (const std::size_t side : {frame + 5, frame + 7}) {
        large[side] = 20000 / 256;
        large[side + 1] = 20000 % 256;
    }
    const long before = peak();
    EXPECT_FALSE(isRead(large));
    EXPECT_LT(peak() - before, 64L << 20);
}

TEST(ImageDecoderTest, SidesAndPixels_AreCapped) {
    const auto flat = [](int width, int height, QImage::Format format = QImage::Format_Mono) {
        QImage image(width, height, format);
        image.fill(0);
        return encoded(image, "PNG");
    };
    EXPECT_TRUE(isRead(flat(8192, 1)));
    EXPECT_FALSE(isRead(flat(8193, 1)));
    EXPECT_TRUE(isRead(flat(4096, 4096)));
    EXPECT_FALSE(isRead(flat(4096, 4097)));
    EXPECT_TRUE(PictureData::of(flat(4096, 2048, QImage::Format_Grayscale16)));
    EXPECT_FALSE(PictureData::of(flat(4096, 2049, QImage::Format_Grayscale16)));
    EXPECT_FALSE(PictureData::of(Bytes(PictureData::kMostBytes + 1)));
}

TEST(ImageDecoderTest, DecodingTheLargest_StaysWithinItsMemory) {
    QImage pixels(4096, 4096, QImage::Format_RGB32);
    pixels.fill(Qt::red);
    const Bytes progressive = encoded(pixels, "JPG", true);
    const long before = peak();
    EXPECT_TRUE(isRead(progressive));
#ifndef __SANITIZE_ADDRESS__  // which keeps what is freed for a while
    EXPECT_LT(peak() - before, 256L << 20);
#else
    static_cast<void>(before);
#endif
}

TEST(ImageDecoderTest, APictureThatEndsEarly_IsRefused) {
    for (const char* format : {"PNG", "JPG"}) {
        const Bytes whole = encoded(noise(20, 20), format);
        ASSERT_TRUE(isRead(whole));
        for (std::size_t size = 0; size < whole.size(); ++size) {
            EXPECT_FALSE(isRead(cut(whole, size))) << format << " " << size;
        }
        EXPECT_TRUE(isRead(whole + "what follows is not looked at"));
    }
}

TEST(ImageDecoderTest, WhatSaysNothingOfThePixels_IsNotHandedOn) {
    const QImage image = noise(20, 20);
    const Bytes png = encoded(image, "PNG");
    const Bytes jpeg = encoded(image, "JPG");
    const Bytes longerPng = inserted(png, kAfterHeader, chunk("zTXt", "bomb") + chunk("iCCP", "bomb"));
    const Bytes longerJpeg = inserted(
        jpeg, kAfterStart, segment('\xE2', "ICC_PROFILE bomb") + segment('\xFE', "bomb") + segment('\xE1', "x"));
    for (const auto& [plain, longer] : {std::pair(png, longerPng), std::pair(jpeg, longerJpeg)}) {
        const auto data = PictureData::of(longer);
        ASSERT_TRUE(data);
        EXPECT_EQ(find(data->essential, "bomb"), data->essential.size());
        ASSERT_TRUE(isRead(longer));
        EXPECT_EQ(ImageDecoder::decode(longer, 100)->pixels, ImageDecoder::decode(plain, 100)->pixels);
    }
}

TEST(ImageDecoderTest, PaletteAndTransparency_AreKept) {
    QImage pixels(4, 4, QImage::Format_Indexed8);
    pixels.setColorTable({qRgba(255, 0, 0, 255), qRgba(0, 255, 0, 64)});
    pixels.fill(1);
    const auto picture = ImageDecoder::decode(encoded(pixels, "PNG"), 100);
    ASSERT_TRUE(picture);
    EXPECT_EQ(picture->pixels.pixelColor(1, 1), QColor(0, 255, 0, 64));
}

TEST(ImageDecoderTest, PicturesAreUpright_HoweverTheCameraWasHeld) {
    for (int orientation = 1; orientation <= 8; ++orientation) {
        const Bytes data = held(orientation);
        QByteArray bytes(reinterpret_cast<const char*>(data.data()), static_cast<qsizetype>(data.size()));
        QBuffer buffer(&bytes);
        QImageReader reader(&buffer);
        reader.setAutoTransform(true);
        const QImage expected = reader.read();
        const auto picture = ImageDecoder::decode(data, 100);
        ASSERT_TRUE(picture) << orientation;
        EXPECT_EQ(picture->pixels, expected) << orientation;
        EXPECT_EQ(picture->original, expected.size()) << orientation;
    }
    for (const int odd : {0, 9, 255}) {
        EXPECT_EQ(PictureData::of(held(odd))->orientation, 1);
    }
}

TEST(ImageDecoderTest, ScansOfAJpeg_AreCapped) {
    const Bytes progressive = encoded(noise(16, 16), "JPG", true);
    const std::size_t end = progressive.size() - 2;
    std::size_t last = 0;
    int scans = 0;
    for (std::size_t at = 0; at + 1 < end; ++at) {
        if (progressive[at] == 0xFF && progressive[at + 1] == 0xDA) {
            last = at;
            ++scans;
        }
    }
    ASSERT_GT(scans, 1);
    const std::string scan(progressive.begin() + static_cast<std::ptrdiff_t>(last),
                           progressive.begin() + static_cast<std::ptrdiff_t>(end));
    Bytes more = progressive;
    for (; scans < PictureData::kMostScans; ++scans) {
        more = inserted(more, end, scan);
    }
    EXPECT_TRUE(PictureData::of(more));
    EXPECT_FALSE(PictureData::of(inserted(more, end, scan)));
}

TEST(ImageDecoderTest, WhatIsNotDoneInTime_IsGivenUp) {
    for (const char* format : {"PNG", "JPG"}) {
        const Bytes data = encoded(noise(1500, 1500), format);
        EXPECT_TRUE(ImageDecoder::decode(data, 100));
        EXPECT_FALSE(ImageDecoder::decode(data, 100, std::chrono::nanoseconds(0)));
        // Enough to begin, not to end.
        EXPECT_FALSE(ImageDecoder::decode(data, 100, std::chrono::milliseconds(1)));
    }
}

TEST(ImageDecoderTest, ASecondFrameOrOneOfAnotherKind_IsRefused) {
    const Bytes jpeg = encoded(noise(16, 16), "JPG");
    const std::size_t frame = find(jpeg, "\xFF\xC0"sv);
    const std::string twice(jpeg.begin() + static_cast<std::ptrdiff_t>(frame),
                            jpeg.begin() + static_cast<std::ptrdiff_t>(frame + 19));
    EXPECT_FALSE(PictureData::of(inserted(jpeg, frame, twice)));
    for (const int marker : {0xC3, 0xC5, 0xC9, 0xCF}) {
        Bytes other = jpeg;
        other[frame + 1] = static_cast<std::uint8_t>(marker);
        EXPECT_FALSE(PictureData::of(other)) << marker;
    }
}

}  // namespace ktr::linux_
