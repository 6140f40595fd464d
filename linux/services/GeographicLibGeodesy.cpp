#include "linux/services/GeographicLibGeodesy.h"

#include <exception>
#include <limits>

#include <GeographicLib/Geodesic.hpp>

namespace ktr::linux_ {

double GeographicLibGeodesy::distance(const platform::Coordinate& from, const platform::Coordinate& to) const {
    constexpr double kNone = std::numeric_limits<double>::quiet_NaN();
    if (!isValid(from) || !isValid(to)) {
        return kNone;
    }
    try {
        double metres = kNone;
        GeographicLib::Geodesic::WGS84().Inverse(from.latitude, from.longitude, to.latitude, to.longitude, metres);
        return metres;
    } catch (const std::exception&) {
        return kNone;
    }
}

}  // namespace ktr::linux_
