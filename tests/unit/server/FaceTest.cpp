#include "server/ingest/Face.h"

#include <gtest/gtest.h>
#include <libdeflate.h>

#include "server/ingest/Base64.h"
#include "server/ingest/JpegFace.h"

namespace ktr::test {

using server::Base64;
using server::Face;
using namespace std::string_literals;

class FaceTest : public ::testing::Test {
  protected:
    /// 24 x 20 pixels in several scans, as Qt wrote them; a preview's header in APP0.
    static std::string jpeg() {
        return Base64::decode(
                   "/9j/4AAQSkZJRgABAQEAZABkAAD/"
                   "2wBDABQODxIPDRQSEBIXFRQYHjIhHhwcHj0sLiQySUBMS0dARkVQWnNiUFVtVkVGZIhlbXd7gY"
                   "KBTmCNl4x9lnN+gXz/"
                   "2wBDARUXFx4aHjshITt8U0ZTfHx8fHx8fHx8fHx8fHx8fHx8fHx8fHx8fHx8fHx8fHx8fHx8fHx8fHx8fHx8"
                   "fHx8fHz/wgARCAAUABgDASIAAhEBAxEB/8QAGAABAAMBAAAAAAAAAAAAAAAAAAMEAgX/"
                   "xAAYAQADAQEAAAAAAAAAAAAAAAABAgQDBf"
                   "/aAAwDAQACEAMQAAAB8y1roM7aNnNzPkUC2f/EABgQAQEBAQEAAAAAAAAAAAAAAAEAAhAR/9oACAEBAAEFAjMZjMZjN5BwL//"
                   "EABgR"
                   "AAMBAQAAAAAAAAAAAAAAAAACAwEh/9oACAEDAQE/AUoLTghh/8QAGhEAAgIDAAAAAAAAAAAAAAAAAAECMSEiMv/"
                   "aAAgBAgEBPwFZNF"
                   "ZDkjR//8QAFBABAAAAAAAAAAAAAAAAAAAAMP/aAAgBAQAGPwIf/8QAFxABAQEBAAAAAAAAAAAAAAAAAQARIP/"
                   "aAAgBAQABPyHkWzMU"
                   "BkV//9oADAMBAAIAAwAAABC734H/xAAXEQEBAQEAAAAAAAAAAAAAAAAAAREh/9oACAEDAQE/EM1SuruP/"
                   "8QAGBEBAQEBAQAAAAAAAA"
                   "AAAAAAAQAhEXH/2gAIAQIBAT8QtU4tnryJP//EABkQAAMBAQEAAAAAAAAAAAAAAAABYRFRIf/aAAgBAQABPxCJAiRIC/"
                   "GazkFnaRzH"
                   "/9k=")
            .value_or("");
    }
    /// 24 x 20 pixels with a resolution and a text.
    static std::string png() {
        return Base64::decode(
                   "iVBORw0KGgoAAAANSUhEUgAAABgAAAAUCAIAAAAY12rUAAAACXBIWXMAAA9hAAAPYQGoP6dpAAAAFHRFWHRDb21tZW50AHNlY3J"
                   "l"
                   "dCBwbGFjZWgPqY0AAACJSURBVDiNrdJLDsIwDADRKZR/"
                   "UqcUcf+jsqgalVCC7SDNxpsny3IHXP9RTwC69jK0a2wN7VsqoN7dJ3Tw"
                   "tQkdHX2DTtYq0NlUHbro+"
                   "wlpf1sD3TQpoVAtQtBDcasBIjwhmqDhPYFHHq2QgEACgWkZBcQBjTBCKrJCaYHKHBvN1r3IBM13ydC0"
                   "7gW2LQ7WGs7UiAAAAABJRU5ErkJggg==")
            .value_or("");
    }
    static std::string chunk(const std::string& type, const std::string& data) {
        const auto number = [](std::uint32_t value) {
            std::string bytes;
            for (const unsigned shift : {24U, 16U, 8U, 0U}) {
                bytes += static_cast<char>(value >> shift & 0xFFU);
            }
            return bytes;
        };
        const std::string body = type + data;
        return number(static_cast<std::uint32_t>(data.size())) + body +
               number(libdeflate_crc32(0, body.data(), body.size()));
    }
    static std::string packed(const std::string& plain) {
        libdeflate_compressor* compressor = libdeflate_alloc_compressor(9);
        std::string bytes(libdeflate_zlib_compress_bound(compressor, plain.size()), '\0');
        bytes.resize(libdeflate_zlib_compress(compressor, plain.data(), plain.size(), bytes.data(), bytes.size()));
        libdeflate_free_compressor(compressor);
        return bytes;
    }
    /// A grey picture of these sides.
    static std::string grey(unsigned width, unsigned height, const std::string& rows, char interlaced = 0) {
        const auto number = [](unsigned value) {
            return "\0\0"s + static_cast<char>(value >> 8U) + static_cast<char>(value & 0xFFU);
        };
        return "\x89PNG\r\n\x1a\n" + chunk("IHDR", number(width) + number(height) + "\x08\0\0\0"s + interlaced) +
               chunk("IDAT", packed(rows)) + chunk("IEND", "");
    }
    static std::string refusal(const std::string& picture) {
        std::string complaint;
        EXPECT_EQ(Face::cleaned(picture, complaint), std::nullopt);
        return complaint;
    }
    static std::string clean(const std::string& picture) {
        std::string complaint;
        const auto face = Face::cleaned(picture, complaint);
        EXPECT_TRUE(face) << complaint;
        return face.value_or("");
    }
    static std::string inserted(std::string picture, std::size_t at, const std::string& what) {
        return picture.insert(at, what);
    }
};

TEST_F(FaceTest, Jpeg_LosesEverythingButThePicture) {
    const std::string face = clean(jpeg());
    EXPECT_EQ(face, inserted(jpeg(), 2, "").erase(2, 18)) << "all but the preview's header";
    EXPECT_EQ(clean(face), face);
    const std::string exif = "\xFF\xE1\0\x10"s + "Exif\0\0SECRET!!"s;
    const std::string comment = "\xFF\xFE\0\x08"s + "SECRET";
    const std::string profile = "\xFF\xE2\0\x08"s + "SECRET";
    EXPECT_EQ(clean(inserted(jpeg(), 20, exif + comment + profile)), face);
    EXPECT_EQ(clean(inserted(jpeg(), 20, "\xFF\xFF\xFF" + comment)), face) << "filled up before a marker";
    const std::size_t last = jpeg().size() - 2;
    EXPECT_EQ(clean(inserted(jpeg(), last, comment)), face) << "behind the last scan";
    EXPECT_EQ(clean(jpeg() + "SECRET"), face) << "behind the end";
}

TEST_F(FaceTest, Jpeg_KeepsWhichColoursItHas_AndNothingBesideThem) {
    const std::string marker = "\xFF\xEE\0\x0E"s + "Adobe\0\x64SECR\0"s;
    EXPECT_EQ(clean(inserted(jpeg(), 20, marker)),
              inserted(clean(jpeg()), 2, "\xFF\xEE\0\x0E"s + "Adobe\0\x64\0\0\0\0\0"s));
    EXPECT_EQ(clean(inserted(jpeg(), 20, "\xFF\xEE\0\x08SECRET"s)), clean(jpeg()));
}

TEST_F(FaceTest, Jpeg_ThatIsDamagedOrUnusual_IsRefused) {
    const std::size_t frame = jpeg().find("\xFF\xC2");
    for (std::size_t size = 3; size < jpeg().size(); size += 7) {
        EXPECT_EQ(refusal(jpeg().substr(0, size)), "is a damaged JPEG") << size;
    }
    auto changed = [&](std::size_t at, const std::string& bytes) { return jpeg().replace(at, bytes.size(), bytes); };
    EXPECT_EQ(refusal(changed(frame + 5, "\x02\x01"s)), "has more than 512 pixels along a side");
    EXPECT_EQ(refusal(changed(frame + 7, "\x02\x01"s)), "has more than 512 pixels along a side");
    EXPECT_EQ(refusal(changed(frame + 5, "\0\0"s)), "is a damaged JPEG");
    EXPECT_EQ(refusal(changed(frame + 4, "\x0C"s)), "is an unusual JPEG: save it as a plain one") << "12 bits";
    EXPECT_EQ(refusal(changed(frame + 1, "\xC9"s)), "is an unusual JPEG: save it as a plain one") << "arithmetic";
    std::string bomb = jpeg().substr(0, jpeg().size() - 2);
    const std::size_t scan = bomb.rfind("\xFF\xDA");
    for (int i = 0; i < server::JpegFace::kMostScans; ++i) {
        bomb += bomb.substr(scan, 10);
    }
    EXPECT_EQ(refusal(bomb + "\xFF\xD9"), "is a damaged JPEG") << "a thousand passes over a picture";
}

TEST_F(FaceTest, Png_LosesEverythingButThePicture) {
    const std::string face = clean(png());
    EXPECT_EQ(face.find("tEXt"), std::string::npos);
    EXPECT_EQ(face.find("secret"), std::string::npos);
    EXPECT_EQ(face.find("pHYs"), std::string::npos);
    EXPECT_EQ(face.size(), png().size() - 32 - 21);
    EXPECT_EQ(clean(face), face);
    const std::size_t end = png().size() - 12;
    EXPECT_EQ(clean(inserted(png(), end, chunk("eXIf", "SECRET"))), face);
    EXPECT_EQ(clean(png() + "SECRET"), face);
}

TEST_F(FaceTest, Png_UnpacksToExactlyItsSize) {
    EXPECT_NE(clean(grey(2, 2, std::string(6, '\0'))), "");
    EXPECT_EQ(refusal(grey(2, 2, std::string(5, '\0'))), "is a damaged PNG");
    EXPECT_EQ(refusal(grey(2, 2, std::string(100000000, '\0'))), "is a damaged PNG") << "a bomb";
    EXPECT_NE(clean(grey(512, 512, std::string(513UL * 512UL, '\0'))), "");
    EXPECT_EQ(refusal(grey(513, 1, std::string(514, '\0'))), "has more than 512 pixels along a side");
    EXPECT_EQ(refusal(grey(0, 1, "")), "is a damaged PNG");
    // Nine by nine in seven passes: 2x2, 1x2, 3x1, 2x3, 5x2, 4x5, 9x4, and a byte before each row.
    EXPECT_NE(clean(grey(9, 9, std::string(81 + 2 + 2 + 1 + 3 + 2 + 5 + 4, '\0'), 1)), "");
    EXPECT_EQ(refusal(grey(9, 9, std::string(90, '\0'), 1)), "is a damaged PNG");
}

TEST_F(FaceTest, Png_ThatIsDamaged_IsRefused) {
    for (std::size_t size = 8; size < png().size(); size += 5) {
        EXPECT_EQ(refusal(png().substr(0, size)), "is a damaged PNG") << size;
    }
    std::string changed = png();
    changed[150] = static_cast<char>(changed[150] ^ 1);
    EXPECT_EQ(refusal(changed), "is a damaged PNG") << "a checksum";
    EXPECT_EQ(refusal(inserted(png(), png().size() - 12, chunk("ABCD", ""))), "is a damaged PNG")
        << "a part that nobody may pass over";
    EXPECT_EQ(refusal(inserted(png(), png().size() - 12, chunk("IDAT", "SECRET"))), "is a damaged PNG")
        << "behind the packed picture";
}

TEST_F(FaceTest, WhatIsNoPicture_OrTooLarge_IsRefused) {
    for (const std::string& bytes : {""s, "GIF89a"s, "<svg/>"s, "\xFF\xD8"s, std::string(100, '\0')}) {
        EXPECT_EQ(refusal(bytes), "is neither a JPEG nor a PNG");
    }
    EXPECT_EQ(refusal(jpeg() + std::string(Face::kMostGiven, 'x')), "is larger than 8 MiB");
    std::string noise;
    for (unsigned state = 1; noise.size() < 257UL * 256UL;) {
        state = state * 1664525U + 1013904223U;
        noise += noise.size() % 257 == 0 ? '\0' : static_cast<char>(state >> 24U);
    }
    EXPECT_EQ(refusal(grey(256, 256, noise)), "is larger than 48 KiB without what is not the picture");
}

TEST_F(FaceTest, Base64_IsStrict) {
    for (const char* bytes : {"", "a", "ab", "abc", "abcd"}) {
        EXPECT_EQ(Base64::decode(Base64::encode(bytes)), bytes);
    }
    for (const char* text : {"=", "A", "AA", "AAA", "AA=", "A A=", "AAAA=", "AB==", "AA-_", "AAAA\n"}) {
        EXPECT_EQ(Base64::decode(text), std::nullopt) << text;
    }
}

}  // namespace ktr::test
