#include <cmath>
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "platform/base/Utf8.h"
#include "tests/fuzz/Require.h"
#include "tiles/Gunzip.h"
#include "tiles/VectorTileDecoder.h"

// Any bytes as a stored vector tile: read or refused within its caps, and what was read refers to nothing beyond
// itself.

namespace {

using ktr::fuzz::require;
using ktr::tiles::MapTile;
using ktr::tiles::VectorTileDecoder;

void check(const MapTile& tile) {
    require(tile.features.size() <= VectorTileDecoder::kMostFeatures, "features are capped");
    require(tile.spots.size() <= VectorTileDecoder::kMostSpots, "spots are capped");
    std::uint32_t last = 0;
    for (const auto end : tile.partEnds) {
        require(end > last && end <= tile.spots.size(), "every part has its spots");
        last = end;
    }
    for (const auto& spot : tile.spots) {
        require(std::isfinite(spot.x) && std::isfinite(spot.y), "spots are numbers");
    }
    for (const auto& name : tile.names) {
        require(name.size() <= VectorTileDecoder::kLongestName && ktr::platform::isValidUtf8(name), "names are text");
    }
    auto kind = ktr::tiles::MapKind::BuiltUp;
    for (const auto& feature : tile.features) {
        require(feature.kind >= kind, "features are sorted");
        kind = feature.kind;
        require(static_cast<std::size_t>(feature.kind) < ktr::tiles::kMapKinds, "kinds are known");
        require(feature.partCount > 0 && feature.firstPart + feature.partCount <= tile.partEnds.size(),
                "a feature has its parts");
        require(feature.name < static_cast<std::int32_t>(tile.names.size()), "a feature has its name");
        require(feature.left <= feature.right && feature.top <= feature.bottom, "a feature covers something");
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    constexpr std::size_t kLargest = std::size_t{1} << 20;
    const auto unpacked = ktr::tiles::gunzip({reinterpret_cast<const char*>(data), size}, kLargest);
    if (!unpacked) {
        return 0;
    }
    require(unpacked->size() <= kLargest, "what is unpacked is capped");
    static const VectorTileDecoder kDecoder("de-AT");
    if (const auto tile = kDecoder.decode({reinterpret_cast<const char*>(unpacked->data()), unpacked->size()})) {
        check(*tile);
    }
    return 0;
}
