#include "platform/map/MapViewport.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "platform/map/Mercator.h"

namespace ktr::platform {

MapViewport MapViewport::between(const MapViewport& from, const MapViewport& to, double progress) {
    if (progress >= 1.0) {
        return to;
    }
    const double zoom = from.zoom + (to.zoom - from.zoom) * progress;
    const double first = 1.0 / mercatorWorld(from.zoom);
    const double last = 1.0 / mercatorWorld(to.zoom);
    const double now = 1.0 / mercatorWorld(zoom);
    const double part = std::abs(last - first) > 1e-6 * first ? (now - first) / (last - first) : progress;
    const Point a = mercatorPoint(from.centre);
    const Point b = mercatorPoint(to.centre);
    const double dx = b.x - a.x;
    return {mercatorCoordinate({a.x + (dx - std::round(dx)) * part, a.y + (b.y - a.y) * part}), zoom, to.size};
}

Point MapViewport::pointFor(const Coordinate& coordinate) const {
    const Point middle = mercatorPoint(centre);
    const Point there = mercatorPoint(coordinate);
    const double x = there.x - middle.x;
    const double world = mercatorWorld(zoom);
    return {(x - std::round(x)) * world + size.width / 2.0, (there.y - middle.y) * world + size.height / 2.0};
}

Coordinate MapViewport::coordinateAt(const Point& point) const {
    const Point middle = mercatorPoint(centre);
    const double world = mercatorWorld(zoom);
    return mercatorCoordinate(
        {middle.x + (point.x - size.width / 2.0) / world, middle.y + (point.y - size.height / 2.0) / world});
}

double MapViewport::metresPerPoint() const {
    const double degrees = std::clamp(centre.latitude, -kLastMercatorLatitude, kLastMercatorLatitude);
    return kMercatorEquatorMetres * std::cos(degrees * std::numbers::pi / 180.0) / mercatorWorld(zoom);
}

}  // namespace ktr::platform
