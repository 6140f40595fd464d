#pragma once

#include <optional>

#include "platform/base/Api.h"
#include "platform/location/PlatformLocation.h"

namespace ktr::platform {

/// Measures on the WGS84 ellipsoid. Any thread.
class KTR_API Geodesy {
  public:
    virtual ~Geodesy();
    /// Metres along the shortest geodesic; NaN when a coordinate is invalid.
    virtual double distance(const Coordinate& from, const Coordinate& to) const = 0;
    /// Metres.
    struct Bounds {
        double least = 0.0;
        double most = 0.0;
    };
    /// Between what `distance` lies, where that can be told for much less than measuring it: enough for whoever rounds
    /// it. None elsewhere; the base cannot tell it anywhere.
    virtual std::optional<Bounds> distanceBounds(const Coordinate& from, const Coordinate& to) const;
    /// The direction in which the shortest geodesic leaves `from`: degrees clockwise from true north, at least 0 and
    /// below 360; NaN when a coordinate is invalid or both are one.
    virtual double azimuth(const Coordinate& from, const Coordinate& to) const = 0;
    /// Where the geodesic that leaves `from` in this direction is after so many metres (negative: backwards). Not a
    /// valid coordinate (NaN) when `from` is invalid or a number is not finite.
    virtual Coordinate destination(const Coordinate& from, double azimuthDegrees, double metres) const = 0;
};

}  // namespace ktr::platform
