#include "linux/maps/VectorPainter.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace ktr::linux_ {

namespace {

/// A surface of more points is filled part by part.
constexpr int kMostElements = 20'000;

/// The features of one kind: they stand together.
template <class Receiver>
void eachOf(const tiles::MapTile& tile, tiles::MapKind kind, const Receiver& receive) {
    const auto first = std::lower_bound(
        tile.features.begin(), tile.features.end(), kind,
        [](const tiles::MapTile::Feature& feature, tiles::MapKind wanted) { return feature.kind < wanted; });
    for (auto feature = first; feature != tile.features.end() && feature->kind == kind; ++feature) {
        receive(*feature);
    }
}

QPen roundPen(const QColor& color, double width) {
    return {color, width, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin};
}

}  // namespace

VectorPainter::VectorPainter(const MapDrawing& drawing, const std::vector<VisibleTile>& tiles, const MapScale& scale)
    : drawing_(drawing),
      painter_(drawing.painter),
      tiles_(tiles),
      scale_(scale),
      budget_(drawing),
      style_(MapStyle::of(drawing.request.isDark, drawing.request.isHighContrast)) {}

void VectorPainter::each(tiles::MapKind kind, tiles::MapTile::Shape shape, const Receiver& receive) const {
    for (const auto& visible : tiles_) {
        const TileGeometry geometry(visible);
        eachOf(*visible.tile, kind, [&](const tiles::MapTile::Feature& feature) {
            if (feature.shape == shape && !feature.isNameOnly && geometry.isVisible(feature)) {
                receive(geometry, feature);
            }
        });
    }
}

std::vector<QPolygonF> VectorPainter::lines(tiles::MapKind kind) const {
    std::vector<QPolygonF> pieces;
    each(kind, tiles::MapTile::Shape::Lines, [&](const TileGeometry& geometry, const tiles::MapTile::Feature& feature) {
        geometry.eachLine(feature, [&](const QPolygonF& piece, double /*from*/) { pieces.push_back(piece); });
    });
    return pieces;
}

void VectorPainter::fill(tiles::MapKind kind, const QColor& color) {
    // What is cut at a tile's edge is filled as one surface: no seam. The rest is filled piece by piece: the painter's
    // time grows faster than the size of a surface.
    QPainterPath cut;
    cut.setFillRule(Qt::WindingFill);
    const auto fillPath = [&](const QPainterPath& path) {
        if (budget_.takeArea(path)) {
            painter_.fillPath(path, color);
        }
    };
    each(kind, tiles::MapTile::Shape::Areas, [&](const TileGeometry& geometry, const tiles::MapTile::Feature& feature) {
        if (!geometry.isInside(feature)) {
            geometry.addArea(feature, cut);
            if (cut.elementCount() > kMostElements) {
                fillPath(cut);
                cut.clear();
            }
            return;
        }
        QPainterPath whole;
        whole.setFillRule(Qt::WindingFill);
        geometry.addArea(feature, whole);
        fillPath(whole);
    });
    fillPath(cut);
}

void VectorPainter::strokeEdges(tiles::MapKind kind, const QColor& color, double width) {
    painter_.setPen(roundPen(color, width));
    each(kind, tiles::MapTile::Shape::Areas, [&](const TileGeometry& geometry, const tiles::MapTile::Feature& feature) {
        geometry.eachEdge(feature, [&](const QPolygonF& piece, double /*from*/) { strokeLine(piece, width); });
    });
}

void VectorPainter::strokeBuildings() {
    // Walls are straight and thin: side by side they are drawn four times as fast as one line that turns, and look
    // alike.
    constexpr double kWidth = MapStyle::kBuildingEdgeWidth;
    painter_.setPen(QPen(style_.buildingEdge, kWidth, Qt::SolidLine, Qt::FlatCap));
    QList<QLineF> walls;
    each(tiles::MapKind::Building, tiles::MapTile::Shape::Areas,
         [&](const TileGeometry& geometry, const tiles::MapTile::Feature& feature) {
             geometry.eachEdge(feature, [&](const QPolygonF& piece, double /*from*/) {
                 if (budget_.takeLine(piece, kWidth)) {
                     walls.clear();
                     for (qsizetype i = 1; i < piece.size(); ++i) {
                         walls.append(QLineF(piece[i - 1], piece[i]));
                     }
                     painter_.drawLines(walls);
                 }
             });
         });
}

void VectorPainter::strokeLines(const std::vector<QPolygonF>& pieces, const QColor& color, double width) {
    if (width > 0.0) {
        painter_.setPen(roundPen(color, width));
        for (const auto& piece : pieces) {
            strokeLine(piece, width);
        }
    }
}

void VectorPainter::strokeLine(const QPolygonF& piece, double width) {
    if (budget_.takeLine(piece, width)) {
        painter_.drawPolyline(piece);
    }
}

void VectorPainter::draw() {
    painter_.setRenderHint(QPainter::Antialiasing);
    painter_.setBrush(Qt::NoBrush);
    for (const auto step : {&VectorPainter::drawSurfaces, &VectorPainter::drawBuildings, &VectorPainter::drawRoads,
                            &VectorPainter::drawRails}) {
        if (drawing_.stop.stop_requested()) {
            return;
        }
        (this->*step)();
    }
    drawDashed(tiles::MapKind::Boundary, style_.boundary, MapStyle::kBoundaryWidth * scale_.lineFactor(),
               {7.0, 3.0, 1.5, 3.0});
}

void VectorPainter::drawSurfaces() {
    fill(tiles::MapKind::BuiltUp, style_.builtUp);
    // Edges first, twice as wide, then the surface: where areas touch, no line divides them.
    strokeEdges(tiles::MapKind::Park, style_.parkEdge, 2.0 * MapStyle::kParkEdgeWidth);
    fill(tiles::MapKind::Park, style_.park);
    drawWater();
    fill(tiles::MapKind::Square, style_.square);
    fill(tiles::MapKind::Pier, style_.pier);
    const double pier = std::clamp(5.0 / scale_.metresPerPoint(), 0.8, 8.0);
    painter_.setPen(QPen(style_.pier, pier, Qt::SolidLine, Qt::FlatCap, Qt::RoundJoin));
    for (const auto& piece : lines(tiles::MapKind::PierLine)) {
        strokeLine(piece, pier);
    }
}

void VectorPainter::drawWater() {
    const double shore = MapStyle::kShoreWidth * scale_.lineFactor();
    struct River {
        QPolygonF line;
        double width;
    };
    std::vector<River> rivers;
    each(tiles::MapKind::WaterLine, tiles::MapTile::Shape::Lines,
         [&](const TileGeometry& geometry, const tiles::MapTile::Feature& feature) {
             const double width = scale_.waterLine(feature.rank);
             if (width > 0.0) {
                 geometry.eachLine(feature, [&](const QPolygonF& piece, double /*from*/) {
                     rivers.push_back({piece, width});
                 });
             }
         });
    const auto drawRivers = [&](const QColor& color, double more) {
        for (const auto& river : rivers) {
            painter_.setPen(roundPen(color, river.width + more));
            strokeLine(river.line, river.width + more);
        }
    };
    strokeEdges(tiles::MapKind::Water, style_.shore, 2.0 * shore);
    drawRivers(style_.shore, shore);
    fill(tiles::MapKind::Water, style_.water);
    drawRivers(style_.water, 0.0);
}

void VectorPainter::drawBuildings() {
    if (scale_.showsBuildings()) {
        fill(tiles::MapKind::Building, style_.building);
        strokeBuildings();
    }
}

void VectorPainter::drawRoads() {
    drawDashed(tiles::MapKind::Path, style_.path, scale_.road(tiles::MapKind::Path).fill, {3.0, 2.4});
    struct Class {
        tiles::MapKind kind;
        QColor fill, casing;
        std::vector<QPolygonF> pieces;
    };
    std::array<Class, 4> classes = {{{tiles::MapKind::Service, style_.minor, style_.minorCasing, {}},
                                     {tiles::MapKind::Minor, style_.minor, style_.minorCasing, {}},
                                     {tiles::MapKind::Secondary, style_.secondary, style_.secondaryCasing, {}},
                                     {tiles::MapKind::Major, style_.major, style_.majorCasing, {}}}};
    for (auto& road : classes) {
        if (scale_.road(road.kind).fill > 0.0) {
            road.pieces = lines(road.kind);
            strokeLines(road.pieces, road.casing, scale_.road(road.kind).casing);
        }
    }
    for (const auto& road : classes) {
        strokeLines(road.pieces, road.fill, scale_.road(road.kind).fill);
    }
}

void VectorPainter::drawDashed(tiles::MapKind kind, const QColor& color, double width,
                               const std::vector<double>& dashes) {
    if (width <= 0.0) {
        return;
    }
    QPen pen(color, width, Qt::SolidLine, Qt::FlatCap, Qt::RoundJoin);
    QList<qreal> pattern;  // in widths of the pen
    double period = 0.0;
    for (const double dash : dashes) {
        pattern.append(dash / width);
        period += dash;
    }
    pen.setDashPattern(pattern);
    each(kind, tiles::MapTile::Shape::Lines, [&](const TileGeometry& geometry, const tiles::MapTile::Feature& feature) {
        geometry.eachLine(feature, [&](const QPolygonF& piece, double from) {
            pen.setDashOffset(std::fmod(from, period) / width);
            painter_.setPen(pen);
            strokeLine(piece, width);
        });
    });
}

void VectorPainter::drawRails() {
    const double factor = scale_.lineFactor();
    strokeLines(lines(tiles::MapKind::Rail), style_.rail, MapStyle::kRailWidth * factor);
    if (factor >= 0.75) {
        drawDashed(tiles::MapKind::Rail, style_.railInner, MapStyle::kRailInnerWidth * factor, {6.0, 6.0});
    }
}

}  // namespace ktr::linux_
