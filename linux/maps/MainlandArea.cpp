#include "linux/maps/MainlandArea.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>
#include <utility>

#include "platform/map/Mercator.h"

namespace ktr::linux_ {

namespace {

using Lines = std::vector<WorldMap::Line>;

template <typename Each>
void forEdges(const Lines& lines, Each each) {
    for (const WorldMap::Line& line : lines) {
        for (std::size_t i = 1; i < line.points.size(); ++i) {
            each(line.points[i - 1], line.points[i]);
        }
    }
}

/// The square of the distance to the nearest edge.
double nearest(const Lines& lines, QPointF place) {
    double least = std::numeric_limits<double>::infinity();
    forEdges(lines, [&](QPointF a, QPointF b) {
        const QPointF way = b - a;
        const QPointF there = place - a;
        const double length = QPointF::dotProduct(way, way);
        const double share = length > 0.0 ? std::clamp(QPointF::dotProduct(there, way) / length, 0.0, 1.0) : 0.0;
        const QPointF off = there - way * share;
        least = std::min(least, QPointF::dotProduct(off, off));
    });
    return least;
}

}  // namespace

MainlandArea::MainlandArea(WorldMap::Outline outline) : outline_(std::move(outline)) {
    for (const auto* lines : {&outline_.coasts, &outline_.borders, &outline_.cityBorders}) {
        for (const WorldMap::Line& line : *lines) {
            bounds_ = bounds_.isNull() ? line.bounds : bounds_.united(line.bounds);
        }
    }
    // The scale of the map is less than two as far north as the country reaches.
    const double margin = 2.0 * kSeaMetres / platform::kMercatorEquatorMetres;
    bounds_.adjust(-margin, -margin, margin, margin);
}

bool MainlandArea::isInside(QPointF place) const {
    bool inside = false;
    for (const auto* lines : {&outline_.coasts, &outline_.borders, &outline_.cityBorders}) {
        forEdges(*lines, [&](QPointF a, QPointF b) {
            if ((a.y() > place.y()) != (b.y() > place.y()) &&
                place.x() < (b.x() - a.x()) * (place.y() - a.y()) / (b.y() - a.y()) + a.x()) {
                inside = !inside;
            }
        });
    }
    return inside;
}

bool MainlandArea::contains(const platform::Coordinate& coordinate) const {
    if (!platform::isValid(coordinate)) {
        return false;
    }
    const platform::Point point = platform::mercatorPoint(coordinate);
    const QPointF place(point.x, point.y);
    if (!bounds_.contains(place)) {
        return false;
    }
    if (isInside(place)) {
        return true;
    }
    const double metres = platform::kMercatorEquatorMetres * std::cos(coordinate.latitude * std::numbers::pi / 180.0);
    const auto within = [&](double square, double most) { return std::sqrt(square) * metres <= most; };
    const double border = nearest(outline_.borders, place);
    const double cityBorder = nearest(outline_.cityBorders, place);
    if (within(border, kBorderMetres) && border < cityBorder) {
        return true;
    }
    const double coast = nearest(outline_.coasts, place);
    return within(coast, kSeaMetres) && coast < std::min({border, cityBorder, nearest(outline_.foreignShores, place)});
}

}  // namespace ktr::linux_
