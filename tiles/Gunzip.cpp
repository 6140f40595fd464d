#include "tiles/Gunzip.h"

#include <libdeflate.h>

#include <algorithm>
#include <memory>

namespace ktr::tiles {

namespace {

struct FreeDecompressor {
    void operator()(libdeflate_decompressor* decompressor) const { libdeflate_free_decompressor(decompressor); }
};

std::uint8_t byteAt(std::string_view data, std::size_t index) {
    return static_cast<std::uint8_t>(data[index]);
}

bool isGzip(std::string_view data) {
    return data.size() >= 18 && byteAt(data, 0) == 0x1F && byteAt(data, 1) == 0x8B;
}

bool isZlib(std::string_view data) {
    return data.size() >= 8 && byteAt(data, 0) == 0x78 && (byteAt(data, 0) * 256 + byteAt(data, 1)) % 31 == 0;
}

/// The size that a gzip member says it has: a hint, no promise.
std::size_t promised(std::string_view data) {
    std::size_t size = 0;
    for (std::size_t index = 1; index <= 4; ++index) {
        size = size * 256 + byteAt(data, data.size() - index);
    }
    return size;
}

}  // namespace

std::optional<platform::Bytes> gunzip(std::string_view data, std::size_t largest) {
    const bool gzip = isGzip(data);
    if (!gzip && !isZlib(data)) {
        return data.size() <= largest ? std::optional(platform::Bytes(data.begin(), data.end())) : std::nullopt;
    }
    const std::unique_ptr<libdeflate_decompressor, FreeDecompressor> decompressor(libdeflate_alloc_decompressor());
    if (!decompressor) {
        return std::nullopt;
    }
    std::size_t room =
        std::clamp(gzip ? promised(data) : data.size() * 4, std::min(std::size_t{4096}, largest), largest);
    while (true) {
        platform::Bytes unpacked(room);
        std::size_t size = 0;
        const auto result = gzip ? libdeflate_gzip_decompress(decompressor.get(), data.data(), data.size(),
                                                              unpacked.data(), room, &size)
                                 : libdeflate_zlib_decompress(decompressor.get(), data.data(), data.size(),
                                                              unpacked.data(), room, &size);
        if (result == LIBDEFLATE_SUCCESS) {
            unpacked.resize(size);
            return unpacked;
        }
        if (result != LIBDEFLATE_INSUFFICIENT_SPACE || room >= largest) {
            return std::nullopt;
        }
        room = std::min(room * 4, largest);
    }
}

}  // namespace ktr::tiles
