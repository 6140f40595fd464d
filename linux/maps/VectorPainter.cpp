#include "linux/maps/VectorPainter.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace ktr::linux_ {

namespace {

/// The features of one kind: they stand together.
template <class Receiver>
void eachOf(const MapTile& tile, MapKind kind, const Receiver& receive) {
    const auto first =
        std::lower_bound(tile.features.begin(), tile.features.end(), kind,
                         [](const MapTile::Feature& feature, MapKind wanted) { return feature.kind < wanted; });
    for (auto feature = first; feature != tile.features.end() && feature->kind == kind; ++feature) {
        receive(*feature);
    }
}

}  // namespace

VectorPainter::VectorPainter(const MapDrawing& drawing, const std::vector<VisibleTile>& tiles, const MapScale& scale)
    : drawing_(drawing),
      painter_(drawing.painter),
      tiles_(tiles),
      scale_(scale),
      style_(MapStyle::of(drawing.request.isDark, drawing.request.isHighContrast)) {}

QPainterPath VectorPainter::collect(MapKind kind, Part part) const {
    QPainterPath path;
    path.setFillRule(Qt::WindingFill);
    for (const auto& visible : tiles_) {
        const TileGeometry geometry(visible);
        eachOf(*visible.tile, kind, [&](const MapTile::Feature& feature) {
            const auto shape = part == Part::Lines ? MapTile::Shape::Lines : MapTile::Shape::Areas;
            if (feature.shape != shape || !geometry.isVisible(feature)) {
                return;
            }
            switch (part) {
                case Part::Areas:
                    geometry.addArea(feature, path);
                    break;
                case Part::Edges:
                    geometry.addEdges(feature, path);
                    break;
                case Part::Lines:
                    geometry.addLines(feature, path);
                    break;
            }
        });
    }
    return path;
}

void VectorPainter::stroke(const QPainterPath& path, const QColor& color, double width) {
    if (!path.isEmpty() && width > 0.0) {
        painter_.strokePath(path, QPen(color, width, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    }
}

void VectorPainter::draw() {
    painter_.setRenderHint(QPainter::Antialiasing);
    for (const auto step : {&VectorPainter::drawSurfaces, &VectorPainter::drawBuildings, &VectorPainter::drawRoads,
                            &VectorPainter::drawRails}) {
        if (drawing_.stop.stop_requested()) {
            return;
        }
        (this->*step)();
    }
    drawDashed(MapKind::Boundary, style_.boundary, MapStyle::kBoundaryWidth * scale_.lineFactor(),
               {7.0, 3.0, 1.5, 3.0});
}

void VectorPainter::drawSurfaces() {
    painter_.fillPath(collect(MapKind::BuiltUp, Part::Areas), style_.builtUp);
    // Edges first, twice as wide, then the surface: where areas touch, no line divides them.
    stroke(collect(MapKind::Park, Part::Edges), style_.parkEdge, 2.0 * MapStyle::kParkEdgeWidth);
    painter_.fillPath(collect(MapKind::Park, Part::Areas), style_.park);
    drawWater();
    painter_.fillPath(collect(MapKind::Square, Part::Areas), style_.square);
    painter_.fillPath(collect(MapKind::Pier, Part::Areas), style_.pier);
    const double pier = std::clamp(5.0 / scale_.metresPerPoint(), 0.8, 8.0);
    painter_.strokePath(collect(MapKind::PierLine, Part::Lines),
                        QPen(style_.pier, pier, Qt::SolidLine, Qt::FlatCap, Qt::RoundJoin));
}

void VectorPainter::drawWater() {
    const double shore = MapStyle::kShoreWidth * scale_.lineFactor();
    std::array<QPainterPath, 256> lines;
    for (const auto& visible : tiles_) {
        const TileGeometry geometry(visible);
        eachOf(*visible.tile, MapKind::WaterLine, [&](const MapTile::Feature& feature) {
            if (feature.shape == MapTile::Shape::Lines && geometry.isVisible(feature)) {
                geometry.addLines(feature, lines[feature.rank]);
            }
        });
    }
    const auto eachWidth = [&](const QColor& color, double more) {
        for (std::size_t metres = 0; metres < lines.size(); ++metres) {
            const double width = scale_.waterLine(static_cast<double>(metres));
            if (width > 0.0) {
                stroke(lines[metres], color, width + more);
            }
        }
    };
    stroke(collect(MapKind::Water, Part::Edges), style_.shore, 2.0 * shore);
    eachWidth(style_.shore, shore);
    painter_.fillPath(collect(MapKind::Water, Part::Areas), style_.water);
    eachWidth(style_.water, 0.0);
}

void VectorPainter::drawBuildings() {
    if (!scale_.showsBuildings()) {
        return;
    }
    painter_.fillPath(collect(MapKind::Building, Part::Areas), style_.building);
    stroke(collect(MapKind::Building, Part::Edges), style_.buildingEdge, MapStyle::kBuildingEdgeWidth);
}

void VectorPainter::drawRoads() {
    drawDashed(MapKind::Path, style_.path, scale_.road(MapKind::Path).fill, {3.0, 2.4});
    struct Class {
        MapKind kind;
        QColor fill, casing;
    };
    const std::array<Class, 4> classes = {{{MapKind::Service, style_.minor, style_.minorCasing},
                                           {MapKind::Minor, style_.minor, style_.minorCasing},
                                           {MapKind::Secondary, style_.secondary, style_.secondaryCasing},
                                           {MapKind::Major, style_.major, style_.majorCasing}}};
    std::array<QPainterPath, 4> paths;
    for (std::size_t index = 0; index < classes.size(); ++index) {
        if (scale_.road(classes[index].kind).fill > 0.0) {
            paths[index] = collect(classes[index].kind, Part::Lines);
            stroke(paths[index], classes[index].casing, scale_.road(classes[index].kind).casing);
        }
    }
    for (std::size_t index = 0; index < classes.size(); ++index) {
        stroke(paths[index], classes[index].fill, scale_.road(classes[index].kind).fill);
    }
}

void VectorPainter::drawDashed(MapKind kind, const QColor& color, double width, const std::vector<double>& dashes) {
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
    for (const auto& visible : tiles_) {
        const TileGeometry geometry(visible);
        eachOf(*visible.tile, kind, [&](const MapTile::Feature& feature) {
            if (feature.shape != MapTile::Shape::Lines || !geometry.isVisible(feature)) {
                return;
            }
            geometry.eachLine(feature, [&](const QPolygonF& piece, double from) {
                pen.setDashOffset(std::fmod(from, period) / width);
                painter_.setPen(pen);
                painter_.drawPolyline(piece);
            });
        });
    }
}

void VectorPainter::drawRails() {
    const double factor = scale_.lineFactor();
    const QPainterPath path = collect(MapKind::Rail, Part::Lines);
    painter_.strokePath(path,
                        QPen(style_.rail, MapStyle::kRailWidth * factor, Qt::SolidLine, Qt::FlatCap, Qt::RoundJoin));
    if (factor >= 0.75) {
        drawDashed(MapKind::Rail, style_.railInner, MapStyle::kRailInnerWidth * factor, {6.0, 6.0});
    }
}

}  // namespace ktr::linux_
