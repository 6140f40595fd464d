#include "linux/maps/MapTiles.h"

#include <algorithm>
#include <cmath>

#include "platform/map/Mercator.h"

namespace ktr::linux_ {

namespace {

/// Edges of tiles are given up to here: a coarse tile reaches far beyond a picture that shows a street.
constexpr double kFarPixels = 1 << 20;

}  // namespace

std::vector<PlacedTile> MapTiles::of(const MapDrawing& drawing, int level) {
    const auto& viewport = drawing.request.viewport;
    if (level < 0 || level > 30) {
        return {};
    }
    const int count = 1 << level;
    const double side = platform::mercatorWorld(viewport.zoom - level);
    // The copy of the world that holds the centre.
    const platform::Point world = viewport.pointFor({platform::kLastMercatorLatitude, -180.0});
    const double centreColumn = platform::mercatorPoint(viewport.centre).x * count;
    const double left = viewport.size.width / 2.0 - centreColumn * side;
    const double top = world.y;
    const auto index = [&](double points) { return static_cast<long>(std::floor(points / side)); };
    const long firstColumn = index(-left);
    const long lastColumn = index(std::nextafter(viewport.size.width - left, -1.0));
    const long firstRow = std::max(0L, index(-top));
    const long lastRow = std::min<long>(count - 1, index(std::nextafter(viewport.size.height - top, -1.0)));
    if (lastRow < firstRow || (lastColumn - firstColumn + 1) * (lastRow - firstRow + 1) > kMostTiles) {
        return {};
    }
    const double xScale = drawing.pixels.width() / viewport.size.width;
    const double yScale = drawing.pixels.height() / viewport.size.height;
    const auto pixel = [](double exact) {
        return static_cast<int>(std::lround(std::clamp(exact, -kFarPixels, kFarPixels)));
    };
    const auto pixelX = [&](long column) { return pixel((left + static_cast<double>(column) * side) * xScale); };
    const auto pixelY = [&](long row) { return pixel((top + static_cast<double>(row) * side) * yScale); };
    std::vector<PlacedTile> tiles;
    for (long row = firstRow; row <= lastRow; ++row) {
        for (long column = firstColumn; column <= lastColumn; ++column) {
            const long wrapped = ((column % count) + count) % count;
            tiles.push_back(
                {{level, static_cast<int>(wrapped), static_cast<int>(row)},
                 QRect(QPoint(pixelX(column), pixelY(row)), QPoint(pixelX(column + 1) - 1, pixelY(row + 1) - 1)),
                 QRectF(left + static_cast<double>(column) * side, top + static_cast<double>(row) * side, side, side)});
        }
    }
    return tiles;
}

int MapTiles::level(const platform::MapViewport& viewport, double points, int lowest, int highest) {
    const double exact = viewport.zoom - std::log2(points / 256.0);
    return std::clamp(static_cast<int>(std::floor(exact + 1e-9)), lowest, std::max(lowest, highest));
}

}  // namespace ktr::linux_
