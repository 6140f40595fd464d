#include "server/rules/Cell.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace ktr::server {

namespace {

/// Metres along a meridian a degree, on a sphere of the earth's mean radius.
constexpr double kMetresPerDegree = 6371008.8 * std::numbers::pi / 180.0;

double heightOf(double side) {
    return side / kMetresPerDegree;
}

/// Cells of a row. The middle of the row decides: its edges differ from it by less than 0.1 % but near the poles, where
/// a row is one cell anyway before that matters.
double columnsOf(std::int64_t row, double side) {
    const double height = heightOf(side);
    const double latitude = (static_cast<double>(row) + 0.5) * height;
    const double narrow = std::min(90.0, std::abs(latitude) + height / 2.0);
    const double around = 360.0 * kMetresPerDegree * std::cos(narrow * std::numbers::pi / 180.0);
    return std::max(1.0, std::floor(around / side));
}

}  // namespace

Cell Cell::of(double latitude, double longitude, double side) {
    Cell cell;
    const double last = std::ceil(90.0 / heightOf(side)) - 1.0;
    cell.row = static_cast<std::int64_t>(std::clamp(std::floor(latitude / heightOf(side)), -last - 1.0, last));
    const double columns = columnsOf(cell.row, side);
    const double place = std::floor((longitude + 180.0) / 360.0 * columns);
    // 180 degrees east is 180 degrees west.
    cell.column = static_cast<std::int64_t>(std::fmod(std::fmod(place, columns) + columns, columns));
    return cell;
}

Cell::Place Cell::place(double side) const {
    const double height = heightOf(side);
    const double columns = columnsOf(row, side);
    Place place;
    place.latitude = std::clamp((static_cast<double>(row) + 0.5) * height, -90.0, 90.0);
    place.longitude = (static_cast<double>(column) + 0.5) * 360.0 / columns - 180.0;
    const double wide = std::max(0.0, std::abs(place.latitude) - height / 2.0);
    const double width = 360.0 / columns * kMetresPerDegree * std::cos(wide * std::numbers::pi / 180.0);
    // A cell about a pole reaches around it.
    place.radius = columns <= 3.0 ? 2.0 * side : std::ceil(std::hypot(side, width) / 2.0);
    return place;
}

}  // namespace ktr::server
