#include "platform/map/LocationShifter.h"

#include <array>
#include <cmath>
#include <numbers>

#include "platform/base/Platform.h"
#include "platform/map/MapPictureSource.h"

namespace ktr::platform {

namespace {

/// The outline of the area, anticlockwise: longitude and latitude. Coarse, and on the sea off the coast.
constexpr std::array kOutline = std::to_array<Point>({
    {73.5, 39.4},  {74.9, 37.2},  {76.5, 35.8},   {78.3, 34.6},  {78.7, 31.5},   {81.2, 30.0},  {84.0, 28.9},
    {86.0, 27.95}, {88.8, 27.9},  {89.7, 28.2},   {91.6, 27.8},  {94.2, 29.1},   {97.3, 28.2},  {97.6, 24.8},
    {98.8, 24.1},  {99.2, 22.1},  {101.7, 21.15}, {102.3, 22.5}, {104.4, 22.75}, {106.6, 22.9}, {108.0, 21.55},
    {108.3, 18.5}, {109.6, 17.8}, {111.6, 19.8},  {114.6, 21.8}, {117.6, 23.2},  {119.4, 24.9}, {120.3, 26.3},
    {122.6, 29.0}, {123.0, 31.5}, {121.6, 35.0},  {123.4, 37.4}, {121.4, 38.5},  {124.3, 39.8}, {126.1, 41.2},
    {128.1, 41.9}, {129.7, 42.4}, {130.6, 42.45}, {131.2, 43.6}, {131.1, 44.85}, {133.1, 45.1}, {135.0, 48.4},
    {131.0, 47.7}, {130.6, 48.9}, {127.6, 49.8},  {126.1, 52.8}, {123.6, 53.5},  {120.3, 53.1}, {119.4, 50.2},
    {117.8, 49.5}, {115.6, 47.8}, {119.6, 46.6},  {116.5, 46.3}, {111.9, 45.0},  {111.7, 43.6}, {107.4, 42.4},
    {104.9, 41.6}, {100.0, 42.7}, {96.4, 42.7},   {95.3, 44.3},  {91.0, 45.2},   {90.9, 46.9},  {87.8, 49.1},
    {85.8, 48.4},  {85.6, 47.2},  {82.9, 47.1},   {82.3, 45.4},  {80.2, 44.9},   {80.8, 43.2},  {80.2, 42.1},
    {76.8, 40.9},  {73.9, 39.9},
});

/// Whether a ray to the east crosses the outline an odd number of times.
bool isInside(const Coordinate& c) {
    bool inside = false;
    for (std::size_t i = 0, j = kOutline.size() - 1; i < kOutline.size(); j = i++) {
        const Point& a = kOutline[i];
        const Point& b = kOutline[j];
        if ((a.y > c.latitude) != (b.y > c.latitude) &&
            c.longitude < (b.x - a.x) * (c.latitude - a.y) / (b.y - a.y) + a.x) {
            inside = !inside;
        }
    }
    return inside;
}

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

Coordinate LocationShifter::shifted(const Coordinate& coordinate, MapDatum datum) {
    if (datum != MapDatum::Gcj02 || !isValid(coordinate) || !isInside(coordinate)) {
        return coordinate;
    }
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
    return shifted(coordinate, installed && installed->maps ? installed->maps->datum() : MapDatum::Wgs84);
}

void LocationShifter::shiftLocation(const std::shared_ptr<PlatformLocation>& location, const Completion& completion) {
    completion(shiftedForInstalledMaps(location ? location->coordinate() : Coordinate{}));
}

}  // namespace ktr::platform
