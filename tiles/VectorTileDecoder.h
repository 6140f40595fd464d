#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "tiles/MapTile.h"

namespace ktr::tiles {

/// Reads vector tiles: Mapbox Vector Tile 1 and 2 (https://github.com/mapbox/vector-tile-spec), unpacked. Any thread.
class VectorTileDecoder {
  public:
    // A tile that holds more than this is cut there: no honest one does.
    static constexpr std::size_t kMostLayers = 128;
    static constexpr std::size_t kMostFeatures = 100'000;
    static constexpr std::size_t kMostSpots = 1'000'000;
    static constexpr std::size_t kLongestName = 160;  ///< bytes; a longer one is no name
    /// An unpacked tile is at most this large; bytes.
    static constexpr std::size_t kLargestTile = std::size_t{16} << 20;

    /// `language` (BCP 47) chooses among the names of a feature; without a name in it, or when it is empty, the name of
    /// the place itself serves.
    explicit VectorTileDecoder(std::string_view language);

    /// None when the tile's structure is damaged. A feature with a geometry that makes no sense is left out alone.
    std::shared_ptr<const MapTile> decode(std::string_view data) const;

  private:
    /// Attribute keys for names, the best first.
    std::vector<std::string> nameKeys_;
};

}  // namespace ktr::tiles
