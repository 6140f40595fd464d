#pragma once

#include "platform/base/Api.h"
#include "platform/base/Geometry.h"
#include "platform/location/PlatformLocation.h"

namespace ktr::platform {

/// What part of the world a rectangle of the screen shows, in Web Mercator (EPSG:3857, spherical): the whole world is a
/// square of 256 × 2^zoom points with longitude −180 at its left edge and latitude 85.0511 at its top. A value; any
/// thread.
struct KTR_API MapViewport {
    Coordinate centre;  ///< in the middle of the rectangle
    double zoom = 0.0;  ///< 0 shows the world in 256 points; need not be whole
    Size size;          ///< points

    /// On the way from one to another, `progress` from 0 to 1: the scale changes evenly to the eye, and what is common
    /// to both stays put.
    static MapViewport between(const MapViewport& from, const MapViewport& to, double progress);

    bool operator==(const MapViewport&) const = default;

    /// Where a coordinate stands, in points from the rectangle's top left corner: the copy of the world that is nearest
    /// to the centre. Latitudes beyond Mercator's are taken as its last.
    Point pointFor(const Coordinate& coordinate) const;
    Coordinate coordinateAt(const Point& point) const;
    /// Ground metres a point at the centre's latitude.
    double metresPerPoint() const;
};

}  // namespace ktr::platform
