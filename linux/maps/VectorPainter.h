#pragma once

#include <functional>
#include <vector>

#include "linux/maps/MapGround.h"
#include "linux/maps/MapScale.h"
#include "linux/maps/MapStyle.h"
#include "linux/maps/PaintBudget.h"
#include "linux/maps/TileGeometry.h"

namespace ktr::linux_ {

/// Draws the surfaces and lines of decoded tiles, without their names. Every kind is drawn for all tiles before the
/// next one, so that streets stay open where tiles meet. Any thread.
class VectorPainter {
  public:
    VectorPainter(const MapDrawing& drawing, const std::vector<VisibleTile>& tiles, const MapScale& scale);

    /// The painter's clip is set by the caller. Returns early when the drawing is stopped.
    void draw();

  private:
    using Receiver = std::function<void(const TileGeometry&, const tiles::MapTile::Feature&)>;

    void each(tiles::MapKind kind, tiles::MapTile::Shape shape, const Receiver& receive) const;
    std::vector<QPolygonF> lines(tiles::MapKind kind) const;
    void fill(tiles::MapKind kind, const QColor& color);
    void strokeEdges(tiles::MapKind kind, const QColor& color, double width);
    void strokeBuildings();
    void strokeLine(const QPolygonF& piece, double width);
    void strokeLines(const std::vector<QPolygonF>& pieces, const QColor& color, double width);
    void drawSurfaces();
    void drawWater();
    void drawBuildings();
    void drawRoads();
    void drawDashed(tiles::MapKind kind, const QColor& color, double width, const std::vector<double>& dashes);
    void drawRails();

    const MapDrawing& drawing_;
    QPainter& painter_;
    const std::vector<VisibleTile>& tiles_;
    const MapScale& scale_;
    PaintBudget budget_;
    const MapStyle& style_;
};

}  // namespace ktr::linux_
