#pragma once

#include <functional>
#include <memory>

#include "platform/location/PlatformLocation.h"

namespace ktr::platform {

/// Converts positions to the datum in which the map is drawn. Main thread.
class KTR_API LocationShifter : public Object {
  public:
    using Completion = std::function<void(const Coordinate& shifted)>;

    /// Calls back once, at once or on a later turn of the main loop. The coordinate stays as it is where the installed
    /// platform's maps are in WGS84, and when it is invalid.
    virtual void shiftLocation(const std::shared_ptr<PlatformLocation>& location, const Completion& completion);

    /// A valid WGS84 coordinate in GCJ-02, wherever it is, by the formulas as they have been published (offsets in
    /// polynomials and sines, on the Krasovsky 1940 ellipsoid). Any thread.
    static Coordinate gcj02(const Coordinate& coordinate);
    /// To the datum of the installed platform's maps.
    static Coordinate shiftedForInstalledMaps(const Coordinate& coordinate);
};

}  // namespace ktr::platform
