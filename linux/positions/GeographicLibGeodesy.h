#pragma once

#include "platform/location/Geodesy.h"

namespace ktr::linux_ {

/// Geodesics by GeographicLib (C. F. F. Karney, "Algorithms for geodesics", J. Geodesy 87, 2013): exact to nanometres.
/// Any thread.
class GeographicLibGeodesy : public platform::Geodesy {
  public:
    double distance(const platform::Coordinate& from, const platform::Coordinate& to) const override;
    /// A fiftieth of a per mille wide, and two micrometres; none for what lies nearly opposite on the earth.
    std::optional<Bounds> distanceBounds(const platform::Coordinate& from,
                                         const platform::Coordinate& to) const override;
    double azimuth(const platform::Coordinate& from, const platform::Coordinate& to) const override;
    platform::Coordinate destination(const platform::Coordinate& from, double azimuthDegrees,
                                     double metres) const override;
};

}  // namespace ktr::linux_
