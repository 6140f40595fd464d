#include "platform/location/PlatformLocation.h"

#include <limits>

#include "platform/base/Json.h"
#include "platform/base/Platform.h"
#include "platform/location/Geodesy.h"

namespace ktr::platform {

PlatformLocation::~PlatformLocation() = default;

bool isValid(const Coordinate& c) {
    return c.latitude >= -90.0 && c.latitude <= 90.0 && c.longitude >= -180.0 && c.longitude <= 180.0;
}

double PlatformLocation::distanceFromLocation(const PlatformLocation& other) const {
    const auto platform = Platform::installed();
    if (!platform || !platform->geodesy) {
        return std::numeric_limits<double>::quiet_NaN();
    }
    return platform->geodesy->distance(coordinate(), other.coordinate());
}

std::string PlatformLocation::description() const {
    return "<" + writeJsonNumber(fix_.coordinate.latitude) + "," + writeJsonNumber(fix_.coordinate.longitude) +
           "> +/- " + writeJsonNumber(fix_.horizontalAccuracy) + "m";
}

}  // namespace ktr::platform
