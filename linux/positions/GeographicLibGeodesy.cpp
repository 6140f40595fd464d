#include "linux/positions/GeographicLibGeodesy.h"

#include <cmath>
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

double GeographicLibGeodesy::azimuth(const platform::Coordinate& from, const platform::Coordinate& to) const {
    constexpr double kNone = std::numeric_limits<double>::quiet_NaN();
    if (!isValid(from) || !isValid(to) || from == to) {
        return kNone;
    }
    try {
        double there = kNone;
        double back = kNone;
        GeographicLib::Geodesic::WGS84().Inverse(from.latitude, from.longitude, to.latitude, to.longitude, there, back);
        const double positive = there < 0.0 ? there + 360.0 : there;
        return positive < 360.0 ? positive : 0.0;
    } catch (const std::exception&) {
        return kNone;
    }
}

platform::Coordinate GeographicLibGeodesy::destination(const platform::Coordinate& from, double azimuthDegrees,
                                                       double metres) const {
    constexpr double kNone = std::numeric_limits<double>::quiet_NaN();
    if (!isValid(from) || !std::isfinite(azimuthDegrees) || !std::isfinite(metres)) {
        return {kNone, kNone};
    }
    try {
        platform::Coordinate there{kNone, kNone};
        GeographicLib::Geodesic::WGS84().Direct(from.latitude, from.longitude, azimuthDegrees, metres, there.latitude,
                                                there.longitude);
        return there;
    } catch (const std::exception&) {
        return {kNone, kNone};
    }
}

}  // namespace ktr::linux_
