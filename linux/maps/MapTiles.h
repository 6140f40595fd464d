#pragma once

#include <vector>

#include <QRect>
#include <QRectF>

#include "linux/maps/MapGround.h"
#include "tiles/TileKey.h"

namespace ktr::linux_ {

/// Where a tile stands in a picture. Neighbours share their edges to the pixel.
struct PlacedTile {
    tiles::TileKey key;
    QRect pixels;   ///< of the picture; may reach beyond it
    QRectF points;  ///< the exact square, in the viewport's points
};

/// The tiles of one level that a picture shows. A value; any thread.
class MapTiles {
  public:
    /// More tiles than this are never asked for: a picture that would show more shows none of the level.
    static constexpr int kMostTiles = 400;

    /// From the north-west, row by row; a world that repeats itself in a wide picture does so with the same keys. None
    /// beyond Mercator's north and south.
    static std::vector<PlacedTile> of(const MapDrawing& drawing, int level);
    /// The level, between `lowest` and `highest`, whose tiles come out between `points` and twice as large.
    static int level(const platform::MapViewport& viewport, double points, int lowest, int highest);
};

}  // namespace ktr::linux_
