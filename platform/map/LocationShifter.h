#pragma once

#include <functional>
#include <memory>

#include "platform/location/PlatformLocation.h"

namespace ktr::platform {

/// The datum in which a map's data gives coordinates.
enum class MapDatum {
    Wgs84,
    Gcj02,  ///< the datum that maps of mainland China must use: places are offset by some hundred metres
};

/// Converts positions to the datum in which the map is drawn. Main thread.
class KTR_API LocationShifter : public Object {
  public:
    using Completion = std::function<void(const Coordinate& shifted)>;

    /// Calls back once, at once or on a later turn of the main loop. The coordinate stays as it is while the installed
    /// platform's map data is in WGS84, outside the area of the other datum, and when it is invalid.
    virtual void shiftLocation(const std::shared_ptr<PlatformLocation>& location, const Completion& completion);

    /// Any thread. The formulas of GCJ-02 as they have been published (offsets in polynomials and sines, on the
    /// Krasovsky 1940 ellipsoid); within mainland China, whose outline is taken coarsely.
    static Coordinate shifted(const Coordinate& coordinate, MapDatum datum);
    /// To the datum of the installed platform's maps.
    static Coordinate shiftedForInstalledMaps(const Coordinate& coordinate);
};

}  // namespace ktr::platform
