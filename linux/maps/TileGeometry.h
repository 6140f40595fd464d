#pragma once

#include <functional>
#include <memory>
#include <vector>

#include <QPainterPath>
#include <QPolygonF>
#include <QRectF>

#include "tiles/MapTile.h"

namespace ktr::linux_ {

/// A tile where a picture shows it. Points of the picture.
struct VisibleTile {
    std::shared_ptr<const tiles::MapTile> tile;
    QRectF square;  ///< the whole tile
    QRectF window;  ///< the part of it that is drawn: inside the tile, and little more than the picture shows
};

/// Takes a tile's features to points and cuts them at the tile's window, so that neighbours meet without gaps or
/// overlaps. A value that refers to its tile; any thread.
class TileGeometry {
  public:
    /// `from` is how far the piece begins from the line's own beginning, in points: dashes stay where they are while
    /// the map moves.
    using LineReceiver = std::function<void(const QPolygonF& piece, double from)>;

    explicit TileGeometry(const VisibleTile& visible);

    bool isVisible(const tiles::MapTile::Feature& feature) const;
    /// Whether nothing of it is cut off.
    bool isInside(const tiles::MapTile::Feature& feature) const;
    /// Rings, to be filled with Qt::WindingFill.
    void addArea(const tiles::MapTile::Feature& feature, QPainterPath& path) const;
    /// The edges of an area as lines, without those that only cut it at the tile's edge. Closed ones end where they
    /// begin.
    void eachEdge(const tiles::MapTile::Feature& feature, const LineReceiver& receive) const;
    void eachLine(const tiles::MapTile::Feature& feature, const LineReceiver& receive) const;
    /// The spots inside the window.
    std::vector<QPointF> spots(const tiles::MapTile::Feature& feature) const;

  private:
    QPointF point(const tiles::MapTile::Spot& spot) const {
        return {visible_.square.x() + static_cast<double>(spot.x) * unit_,
                visible_.square.y() + static_cast<double>(spot.y) * unit_};
    }
    void cutLine(const QPolygonF& line, const LineReceiver& receive) const;

    const VisibleTile& visible_;
    double unit_;  ///< points
};

}  // namespace ktr::linux_
