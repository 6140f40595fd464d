#include "linux/maps/PaintBudget.h"

#include <algorithm>
#include <cmath>

namespace ktr::linux_ {

namespace {

// Costs are in crossings of two edges in a row of pixels: some 15 nanoseconds each.

/// What a pixel of a picture may cost. A dense town takes a tenth of that.
constexpr double kCostAPixel = 200.0;
constexpr double kLeast = 3e7;
constexpr double kMost = 3e8;
/// Of every shape, however small, and of every pixel that it covers.
constexpr double kShapeCost = 2000.0;
constexpr double kCoveredCost = 1.0;

}  // namespace

PaintBudget::PaintBudget(const MapDrawing& drawing)
    : pixels_(drawing.pixels.height() / drawing.request.viewport.size.height),
      left_(std::clamp(kCostAPixel * drawing.pixels.width() * drawing.pixels.height(), kLeast, kMost)),
      stop_(drawing.stop) {}

bool PaintBudget::takeArea(const QPainterPath& path) {
    double edges = 0.0;
    for (int i = 1; i < path.elementCount(); ++i) {
        const auto element = path.elementAt(i);
        if (!element.isMoveTo()) {
            edges += std::abs(element.y - path.elementAt(i - 1).y);
        }
    }
    const QRectF bounds = path.controlPointRect();
    return path.isEmpty() || take(edges, bounds.height(), bounds.width() * bounds.height());
}

bool PaintBudget::takeLine(const QPolygonF& line, double width) {
    double edges = 0.0;
    double length = 0.0;
    for (qsizetype i = 1; i < line.size(); ++i) {
        const QPointF along = line[i] - line[i - 1];
        // Both sides, and the round corner: a line of many points has shallow ones.
        const double step = std::hypot(along.x(), along.y());
        edges += 2.0 * std::abs(along.y()) + std::min(width, step);
        length += step;
    }
    return take(edges, line.boundingRect().height() + width, length * width);
}

bool PaintBudget::take(double edges, double height, double surface) {
    const double reach = edges * pixels_;
    const double cost =
        kShapeCost + kCoveredCost * surface * pixels_ * pixels_ + reach * reach / std::max(1.0, height * pixels_);
    if (!(cost <= left_) || stop_.stop_requested()) {
        return false;
    }
    left_ -= cost;
    return true;
}

}  // namespace ktr::linux_
