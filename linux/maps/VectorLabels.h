#pragma once

#include <map>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include <QPainterPath>
#include <QPolygonF>

#include "linux/maps/MapLabels.h"
#include "linux/maps/MapScale.h"
#include "linux/maps/MapStyle.h"
#include "linux/maps/TileGeometry.h"

namespace ktr::linux_ {

/// Chooses which names of decoded tiles a picture shows, and where: places, then streets, waters and parks by
/// importance; each name of a kind once, however many tiles and pieces it comes in. For one picture; any thread.
class VectorLabels {
  public:
    VectorLabels(const MapDrawing& drawing, const std::vector<VisibleTile>& tiles, const MapScale& scale);

    void place(MapLabels& labels);

  private:
    struct Street {
        tiles::MapKind kind = tiles::MapKind::Service;  ///< the highest of its pieces
        std::vector<QPolygonF> pieces;
        double length = 0.0;  ///< of the longest way through it, once it is joined
    };
    struct Spot {
        tiles::MapKind kind;
        tiles::PlaceRank rank;
        QPointF point;
    };
    using Name = std::string_view;  ///< of a tile

    void collect(const VisibleTile& visible);
    void collectFeature(const TileGeometry& geometry, const tiles::MapTile::Feature& feature, Name name);
    void placePlaces(MapLabels& labels);
    void placeStreets(MapLabels& labels, tiles::MapKind kind);
    void placeAreas(MapLabels& labels, tiles::MapKind kind);
    void placeSpots(MapLabels& labels, tiles::MapKind kind);
    /// Whether one more label may be tried.
    bool mayTry();
    LabelLook lookOf(tiles::MapKind kind) const;
    LabelLook lookOf(tiles::PlaceRank rank) const;

    const MapDrawing& drawing_;
    const std::vector<VisibleTile>& tiles_;
    const MapScale& scale_;
    const MapStyle& style_;
    std::map<Name, Street> streets_;
    std::map<std::pair<tiles::MapKind, Name>, QPainterPath> areas_;
    std::map<std::pair<tiles::MapKind, Name>, Spot> spots_;
    /// Parks and waters that have their name.
    std::vector<std::pair<tiles::MapKind, Name>> named_;
    std::size_t streetPieces_ = 0;
    int tries_ = 0;
};

}  // namespace ktr::linux_
