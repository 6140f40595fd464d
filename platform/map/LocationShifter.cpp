#include "platform/map/LocationShifter.h"

#include <cmath>
#include <numbers>

#include "platform/base/Platform.h"
#include "platform/map/MapPictureSource.h"

namespace ktr::platform {

namespace {

double waves(double first, double second) {
    return (20.0 * std::sin(6.0 * first * std::numbers::pi) + 20.0 * std::sin(2.0 * first * std::numbers::pi)) * 2.0 /
               3.0 +
           second;
}

/// Offsets before they are scaled to the ellipsoid; x and y are degrees east of 105 and north of 35.
double northward(double x, double y) {
    constexpr double pi = std::numbers::pi;
    const double polynomial = -100.0 + 2.0 * x + 3.0 * y + 0.2 * y * y + 0.1 * x * y + 0.2 * std::sqrt(std::abs(x));
    const double slow = (20.0 * std::sin(y * pi) + 40.0 * std::sin(y / 3.0 * pi)) * 2.0 / 3.0 +
                        (160.0 * std::sin(y / 12.0 * pi) + 320.0 * std::sin(y * pi / 30.0)) * 2.0 / 3.0;
    return polynomial + waves(x, slow);
}

double eastward(double x, double y) {
    constexpr double pi = std::numbers::pi;
    const double polynomial = 300.0 + x + 2.0 * y + 0.1 * x * x + 0.1 * x * y + 0.1 * std::sqrt(std::abs(x));
    const double slow = (20.0 * std::sin(x * pi) + 40.0 * std::sin(x / 3.0 * pi)) * 2.0 / 3.0 +
                        (150.0 * std::sin(x / 12.0 * pi) + 300.0 * std::sin(x / 30.0 * pi)) * 2.0 / 3.0;
    return polynomial + waves(x, slow);
}

}  // namespace

Coordinate LocationShifter::gcj02(const Coordinate& coordinate) {
    // Krasovsky 1940: half the long axis in metres, and the eccentricity squared.
    constexpr double a = 6378245.0;
    constexpr double e2 = 0.00669342162296594323;
    constexpr double pi = std::numbers::pi;
    const double x = coordinate.longitude - 105.0;
    const double y = coordinate.latitude - 35.0;
    const double latitude = coordinate.latitude / 180.0 * pi;
    const double magic = 1.0 - e2 * std::sin(latitude) * std::sin(latitude);
    const double root = std::sqrt(magic);
    const double metresNorth = (a * (1.0 - e2)) / (magic * root) * pi / 180.0;
    const double metresEast = a / root * std::cos(latitude) * pi / 180.0;
    return {coordinate.latitude + northward(x, y) / metresNorth, coordinate.longitude + eastward(x, y) / metresEast};
}

Coordinate LocationShifter::shiftedForInstalledMaps(const Coordinate& coordinate) {
    const auto installed = Platform::installed();
    const bool isShifted =
        installed && installed->maps && isValid(coordinate) && installed->maps->isInGcj02(coordinate);
    return isShifted ? gcj02(coordinate) : coordinate;
}

void LocationShifter::shiftLocation(const std::shared_ptr<PlatformLocation>& location, const Completion& completion) {
    completion(shiftedForInstalledMaps(location ? location->coordinate() : Coordinate{}));
}

}  // namespace ktr::platform
