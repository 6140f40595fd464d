// After the PNG specification (ISO/IEC 15948), chapters 5, 7 to 9 and 11.
#include "server/ingest/PngFace.h"

#include <libdeflate.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <memory>
#include <vector>

#include "server/ingest/Face.h"

namespace ktr::server {

namespace {

constexpr std::string_view kSignature("\x89PNG\r\n\x1a\n", 8);

std::uint32_t numberAt(std::string_view bytes, std::size_t at) {
    std::uint32_t number = 0;
    for (std::size_t i = at; i < at + 4; ++i) {
        number = number << 8U | static_cast<unsigned char>(bytes[i]);
    }
    return number;
}

std::uint32_t checksum(std::string_view bytes) {
    return ::libdeflate_crc32(0, bytes.data(), bytes.size());
}

void append(std::string& out, std::uint32_t number) {
    for (int shift = 24; shift >= 0; shift -= 8) {
        out += static_cast<char>(number >> static_cast<unsigned>(shift) & 0xFFU);
    }
}

void appendChunk(std::string& out, std::string_view type, std::string_view data) {
    append(out, static_cast<std::uint32_t>(data.size()));
    std::string body(type);
    body += data;
    out += body;
    append(out, checksum(body));
}

/// What the header says; bits a pixel 0 for a header that is none.
struct Header {
    std::uint32_t width = 0;
    std::uint32_t height = 0;
    unsigned bitsPerPixel = 0;
    bool hasPalette = false;
    bool interlaced = false;
};

Header headerOf(std::string_view data) {
    Header header;
    const auto byte = [&](std::size_t at) { return static_cast<unsigned char>(data[at]); };
    const unsigned depth = byte(8);
    const unsigned colour = byte(9);
    header.width = numberAt(data, 0);
    header.height = numberAt(data, 4);
    header.hasPalette = colour == 3;
    header.interlaced = byte(12) == 1;
    const bool plain = depth == 8 || depth == 16;
    const bool small = depth == 1 || depth == 2 || depth == 4;
    const unsigned channels = colour == 2 ? 3 : colour == 4 ? 2 : colour == 6 ? 4 : 1;
    const bool known = colour == 0   ? plain || small
                       : colour == 3 ? depth == 8 || small
                                     : (colour == 2 || colour == 4 || colour == 6) && plain;
    if (known && byte(10) == 0 && byte(11) == 0 && byte(12) <= 1) {
        header.bitsPerPixel = depth * channels;
    }
    return header;
}

/// Bytes of a picture, or of one pass of it, with the filter's byte before each row.
std::size_t sizeOf(std::uint32_t width, std::uint32_t height, unsigned bitsPerPixel) {
    return width == 0 || height == 0 ? 0 : std::size_t{height} * (1 + (std::size_t{width} * bitsPerPixel + 7) / 8);
}

std::size_t unpackedSize(const Header& header) {
    if (!header.interlaced) {
        return sizeOf(header.width, header.height, header.bitsPerPixel);
    }
    // The seven passes: first column and row, and steps.
    constexpr std::array<std::array<std::uint32_t, 4>, 7> kPasses{
        {{0, 0, 8, 8}, {4, 0, 8, 8}, {0, 4, 4, 8}, {2, 0, 4, 4}, {0, 2, 2, 4}, {1, 0, 2, 2}, {0, 1, 1, 2}}};
    std::size_t size = 0;
    for (const auto& [left, top, across, down] : kPasses) {
        const auto steps = [](std::uint32_t whole, std::uint32_t first, std::uint32_t step) {
            return whole <= first ? 0 : (whole - first + step - 1) / step;
        };
        size += sizeOf(steps(header.width, left, across), steps(header.height, top, down), header.bitsPerPixel);
    }
    return size;
}

/// Whether this is one packed text of exactly so many bytes, with nothing behind it.
bool unpacksTo(std::string_view packed, std::size_t size) {
    const std::unique_ptr<libdeflate_decompressor, decltype(&::libdeflate_free_decompressor)> unpacker(
        ::libdeflate_alloc_decompressor(), ::libdeflate_free_decompressor);
    std::vector<char> room(size);
    std::size_t used = 0;
    std::size_t made = 0;
    return unpacker != nullptr &&
           ::libdeflate_zlib_decompress_ex(unpacker.get(), packed.data(), packed.size(), room.data(), room.size(),
                                           &used, &made) == LIBDEFLATE_SUCCESS &&
           used == packed.size() && made == size;
}

/// What is kept of the chunks of a file.
struct Parts {
    std::string header, palette, transparency, pixels;
    bool ended = false;
};

/// Sorts a chunk; false for one that may not be there.
bool take(std::string_view type, std::string_view data, Parts& parts) {
    if (parts.header.empty() != (type == "IHDR")) {
        return false;
    }
    if (type == "IHDR") {
        parts.header = data;
        return data.size() == 13;
    }
    if (type == "PLTE") {
        const bool first = parts.palette.empty() && parts.pixels.empty();
        parts.palette = data;
        return first && !data.empty() && data.size() <= 768 && data.size() % 3 == 0;
    }
    if (type == "tRNS") {
        const bool first = parts.transparency.empty() && parts.pixels.empty();
        parts.transparency = data;
        return first && !data.empty() && data.size() <= 256;
    }
    if (type == "IDAT") {
        parts.pixels += data;
        return true;
    }
    if (type == "IEND") {
        parts.ended = true;
        return data.empty();
    }
    // A capital letter first: what nobody may pass over.
    return type[0] >= 'a' && type[0] <= 'z';
}

/// False for what is damaged or has unknown parts.
bool split(std::string_view picture, Parts& parts) {
    std::size_t at = kSignature.size();
    while (!parts.ended) {
        if (picture.size() - at < 12) {
            return false;
        }
        const std::size_t size = numberAt(picture, at);
        if (size > picture.size() - at - 12) {
            return false;
        }
        const std::string_view body = picture.substr(at + 4, 4 + size);
        if (checksum(body) != numberAt(picture, at + 8 + size) || !take(body.substr(0, 4), body.substr(4), parts)) {
            return false;
        }
        at += 12 + size;
    }
    return true;
}

}  // namespace

bool PngFace::is(std::string_view picture) {
    return picture.substr(0, kSignature.size()) == kSignature;
}

std::optional<std::string> PngFace::cleaned(std::string_view picture, std::string& complaint) {
    Parts parts;
    if (!split(picture, parts)) {
        complaint = "is a damaged PNG";
        return std::nullopt;
    }
    const Header header = headerOf(parts.header);
    if (header.width > Face::kMostPixels || header.height > Face::kMostPixels) {
        complaint = "has more than 512 pixels along a side";
        return std::nullopt;
    }
    if (header.bitsPerPixel == 0 || header.width == 0 || header.height == 0 ||
        header.hasPalette == parts.palette.empty() || !unpacksTo(parts.pixels, unpackedSize(header))) {
        complaint = "is a damaged PNG";
        return std::nullopt;
    }
    std::string out(kSignature);
    appendChunk(out, "IHDR", parts.header);
    if (!parts.palette.empty()) {
        appendChunk(out, "PLTE", parts.palette);
    }
    if (!parts.transparency.empty()) {
        appendChunk(out, "tRNS", parts.transparency);
    }
    appendChunk(out, "IDAT", parts.pixels);
    appendChunk(out, "IEND", "");
    return out;
}

}  // namespace ktr::server
