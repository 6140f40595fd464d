#include "platform/map/MapViewport.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace ktr::platform {
namespace {

constexpr double kTilePoints = 256.0;
constexpr double kLastLatitude = 85.05112877980659;
constexpr double kEquatorMetres = 40075016.685578488;  // 2π × the sphere's radius, 6,378,137 m

double radians(double degrees) {
    return degrees * std::numbers::pi / 180.0;
}

/// The world as a square of side 1, its origin at the top left.
Point worldPoint(const Coordinate& coordinate) {
    const double latitude = radians(std::clamp(coordinate.latitude, -kLastLatitude, kLastLatitude));
    return {coordinate.longitude / 360.0 + 0.5, 0.5 - std::asinh(std::tan(latitude)) / (2.0 * std::numbers::pi)};
}

double worldPoints(double zoom) {
    return kTilePoints * std::exp2(zoom);
}

}  // namespace

Point MapViewport::pointFor(const Coordinate& coordinate) const {
    const Point middle = worldPoint(centre);
    const Point there = worldPoint(coordinate);
    const double x = there.x - middle.x;
    const double world = worldPoints(zoom);
    return {(x - std::round(x)) * world + size.width / 2.0, (there.y - middle.y) * world + size.height / 2.0};
}

Coordinate MapViewport::coordinateAt(const Point& point) const {
    const Point middle = worldPoint(centre);
    const double world = worldPoints(zoom);
    const double x = middle.x + (point.x - size.width / 2.0) / world;
    const double y = middle.y + (point.y - size.height / 2.0) / world;
    const double latitude = std::atan(std::sinh((0.5 - y) * 2.0 * std::numbers::pi)) * 180.0 / std::numbers::pi;
    return {latitude, (x - std::floor(x) - 0.5) * 360.0};
}

double MapViewport::metresPerPoint() const {
    const double latitude = radians(std::clamp(centre.latitude, -kLastLatitude, kLastLatitude));
    return kEquatorMetres * std::cos(latitude) / worldPoints(zoom);
}

}  // namespace ktr::platform
