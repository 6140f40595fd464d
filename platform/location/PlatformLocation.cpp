#include "platform/location/PlatformLocation.h"

#include "platform/base/Json.h"
#include "platform/base/Platform.h"
#include "platform/location/Geodesy.h"

namespace ktr::platform {

PlatformLocation::~PlatformLocation() = default;

bool isValid(const Coordinate& c) {
    return c.latitude >= -90.0 && c.latitude <= 90.0 && c.longitude >= -180.0 && c.longitude <= 180.0;
}

double PlatformLocation::distanceFromLocation(const PlatformLocation& other) const {
    return Platform::installed()->geodesy->distance(coordinate(), other.coordinate());
}

std::string PlatformLocation::description() const {
    return "<" + writeJsonNumber(fix_.coordinate.latitude) + "," + writeJsonNumber(fix_.coordinate.longitude) +
           "> +/- " + writeJsonNumber(fix_.horizontalAccuracy) + "m";
}

}  // namespace ktr::platform
