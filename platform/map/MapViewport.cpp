#include "platform/map/MapViewport.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "platform/map/Mercator.h"

namespace ktr::platform {

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
