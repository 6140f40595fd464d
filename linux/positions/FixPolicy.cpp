#include "linux/positions/FixPolicy.h"

#include <cmath>

namespace ktr::linux_ {

std::optional<platform::PlatformLocation::Fix> FixPolicy::checked(platform::PlatformLocation::Fix fix) {
    // Written so that what is no number is refused.
    const auto isWithin = [](double value, double least, double most) { return value >= least && value <= most; };
    if (!platform::isValid(fix.coordinate) || !isWithin(fix.horizontalAccuracy, 0.0, kMostAccuracy)) {
        return std::nullopt;
    }
    if (!isWithin(fix.altitude, -kMostAltitude, kMostAltitude) || !isWithin(fix.verticalAccuracy, 0.0, kMostAccuracy)) {
        fix.altitude = isWithin(fix.altitude, -kMostAltitude, kMostAltitude) ? fix.altitude : 0.0;
        fix.verticalAccuracy = -1.0;
    }
    if (!isWithin(fix.course, 0.0, 360.0)) {
        fix.course = -1.0;
    }
    if (!isWithin(fix.speed, 0.0, kMostSpeed)) {
        fix.speed = -1.0;
    }
    if (fix.timestamp && !std::isfinite(fix.timestamp->secondsSinceReferenceDate)) {
        fix.timestamp.reset();
    }
    return fix;
}

}  // namespace ktr::linux_
