#include "linux/positions/GeographicLibGeodesy.h"

#include <algorithm>
#include <cmath>
#include <exception>
#include <limits>
#include <numbers>

#include <GeographicLib/Constants.hpp>
#include <GeographicLib/Geodesic.hpp>

namespace ktr::linux_ {

namespace {

constexpr double kRadiansADegree = std::numbers::pi / 180.0;
/// By how much `longLine` may be wrong, of itself. Of two million random lines those up to 5,000 km were wrong by at
/// most 1.5e-6, the others by 4.3e-6.
constexpr double kLongLineError = 1e-5;
/// And in metres: what is lost in the places' own digits.
constexpr double kLeastError = 1e-6;
/// Of the sine of half the angle between two places, squared: beyond some 140 degrees nothing is said of the error.
constexpr double kNearlyOpposite = 0.88;

/// A place on the sphere that stands in for the ellipsoid: sine and cosine of its reduced latitude.
struct Reduced {
    explicit Reduced(double latitudeDegrees) {
        const double latitude = latitudeDegrees * kRadiansADegree;
        const double up = (1.0 - GeographicLib::Constants::WGS84_f()) * std::sin(latitude);
        const double out = std::cos(latitude);
        const double length = std::sqrt(up * up + out * out);
        sine = up / length;
        cosine = out / length;
    }
    double sine;
    double cosine;
};

/// Metres, by Lambert's formula for long lines (W. D. Lambert, "The distance between two widely separated points on the
/// surface of the earth", J. Washington Academy of Sciences 32, 1942), written in sines of half angles, so that short
/// lines lose nothing. None for what lies nearly opposite.
std::optional<double> longLine(const platform::Coordinate& from, const platform::Coordinate& to) {
    const Reduced a(from.latitude);
    const Reduced b(to.latitude);
    const double sineOfTurn = std::sin((to.longitude - from.longitude) / 2.0 * kRadiansADegree);
    const double sineOfRise = b.sine * a.cosine - b.cosine * a.sine;
    const double cosineOfRise = b.cosine * a.cosine + b.sine * a.sine;
    const double halfRise = sineOfRise * sineOfRise / (2.0 * (1.0 + cosineOfRise));
    const double half = halfRise + a.cosine * b.cosine * sineOfTurn * sineOfTurn;
    if (half == 0.0) {
        return 0.0;
    }
    if (!(half < kNearlyOpposite)) {
        return std::nullopt;
    }
    const double angle = 2.0 * std::asin(std::sqrt(half));
    const double sineOfAngle = 2.0 * std::sqrt(half * (1.0 - half));
    const double middle = (1.0 - (a.cosine * b.cosine - a.sine * b.sine)) / 2.0;
    const double x = (angle - sineOfAngle) * middle * (1.0 - halfRise) / (1.0 - half);
    const double y = (angle + sineOfAngle) * (1.0 - middle) * halfRise / half;
    return GeographicLib::Constants::WGS84_a() * (angle - GeographicLib::Constants::WGS84_f() / 2.0 * (x + y));
}

}  // namespace

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

std::optional<platform::Geodesy::Bounds> GeographicLibGeodesy::distanceBounds(const platform::Coordinate& from,
                                                                              const platform::Coordinate& to) const {
    if (!isValid(from) || !isValid(to)) {
        return std::nullopt;
    }
    const auto metres = longLine(from, to);
    if (!metres) {
        return std::nullopt;
    }
    const double error = *metres * kLongLineError + kLeastError;
    return Bounds{std::max(0.0, *metres - error), *metres + error};
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
