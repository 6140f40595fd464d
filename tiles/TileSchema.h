#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

#include "tiles/MapTile.h"

namespace ktr::tiles {

/// What the layers and attributes of vector tiles mean, in the three schemas in use: Shortbread 1, OpenMapTiles 3 and
/// Protomaps 3 and 4. Any thread.
class TileSchema {
  public:
    enum class Kind { Shortbread, OpenMapTiles, Protomaps };

    /// What is read of a feature's attributes; a view is empty when the attribute is missing.
    struct Attributes {
        std::string_view kind;  ///< Shortbread, Protomaps: "kind", "pmap:kind"
        std::string_view kindDetail;
        std::string_view featureClass;  ///< OpenMapTiles: "class"
        std::string_view subclass;
        std::string_view brunnel;  ///< "bridge", "tunnel", "ford"
        std::string_view leisure;  ///< of a point of interest
        std::string_view amenity;
        std::string_view tourism;
        std::int64_t adminLevel = 0;  ///< 0 when it is missing
        std::int64_t populationRank = -1;
        std::int64_t capital = 0;  ///< 2: of a country
        bool maritime = false;
        bool isTunnel = false;
    };
    struct Meaning {
        MapKind kind = MapKind::BuiltUp;
        std::uint8_t rank = 0;
        /// Of a layer that repeats the lines of another one for the names on them.
        bool isNameOnly = false;
    };

    /// By the names of the layers: each known name is a vote. A tile that speaks for none is read as Shortbread.
    class Detector {
      public:
        void add(std::string_view layer);
        Kind kind() const;

      private:
        int shortbread_ = 0;
        int openMapTiles_ = 0;
        int protomaps_ = 0;
    };

    explicit TileSchema(Kind kind) : kind_(kind) {}
    /// Whether anything of this layer is ever drawn.
    bool isDrawn(std::string_view layer) const;
    /// None for what is not drawn.
    std::optional<Meaning> meaning(std::string_view layer, const Attributes& attributes, MapTile::Shape shape) const;

  private:
    Kind kind_;
};

}  // namespace ktr::tiles
