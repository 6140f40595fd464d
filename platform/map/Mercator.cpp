#include "platform/map/Mercator.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace ktr::platform {

Point mercatorPoint(const Coordinate& coordinate) {
    const double degrees = std::clamp(coordinate.latitude, -kLastMercatorLatitude, kLastMercatorLatitude);
    const double latitude = degrees * std::numbers::pi / 180.0;
    return {coordinate.longitude / 360.0 + 0.5, 0.5 - std::asinh(std::tan(latitude)) / (2.0 * std::numbers::pi)};
}

Coordinate mercatorCoordinate(const Point& point) {
    const double latitude = std::atan(std::sinh((0.5 - point.y) * 2.0 * std::numbers::pi)) * 180.0 / std::numbers::pi;
    return {latitude, (point.x - std::floor(point.x) - 0.5) * 360.0};
}

double mercatorWorld(double zoom) {
    constexpr double kTilePoints = 256.0;
    return kTilePoints * std::exp2(zoom);
}

}  // namespace ktr::platform
