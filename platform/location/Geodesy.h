#pragma once

#include "platform/base/Api.h"
#include "platform/location/PlatformLocation.h"

namespace ktr::platform {

/// Measures on the WGS84 ellipsoid. Any thread.
class KTR_API Geodesy {
  public:
    virtual ~Geodesy();
    /// Metres along the shortest geodesic; NaN when a coordinate is invalid.
    virtual double distance(const Coordinate& from, const Coordinate& to) const = 0;
};

}  // namespace ktr::platform
