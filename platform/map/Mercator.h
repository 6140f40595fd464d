#pragma once

#include "platform/base/Api.h"
#include "platform/base/Geometry.h"
#include "platform/location/PlatformLocation.h"

// Web Mercator (EPSG:3857, spherical), the world as a square of side 1 with its origin at the top left. Any thread.

namespace ktr::platform {

/// The edge of the square, degrees.
inline constexpr double kLastMercatorLatitude = 85.05112877980659;

/// The equator of the sphere, of radius 6,378,137 m; metres.
inline constexpr double kMercatorEquatorMetres = 40075016.685578488;

/// Latitudes beyond the last are taken as it. Longitudes beyond ±180 stand in the next copy of the world.
KTR_API Point mercatorPoint(const Coordinate& coordinate);
/// The longitude within -180..180.
KTR_API Coordinate mercatorCoordinate(const Point& point);
/// The side of the world, points.
KTR_API double mercatorWorld(double zoom);

}  // namespace ktr::platform
