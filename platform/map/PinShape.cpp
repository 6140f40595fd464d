#include "platform/map/PinShape.h"

#include <cmath>
#include <numbers>

#include "platform/ui/Canvas.h"

namespace ktr::platform {

Path PinShape::outline() const {
    const double angle = departure * std::numbers::pi / 180.0;
    const Point middle = centre();
    const Point right{radius * std::sin(angle), middle.y + radius * std::cos(angle)};
    // Two curves run along the circle's tangents nearly as far as the tip is long, and then down to it.
    const double along = 0.95 * tip;
    const Point control{right.x - along * std::cos(angle), right.y + along * std::sin(angle)};
    Path path;
    path.moveTo({-right.x, right.y});
    path.addArc(middle, radius, 90.0 + departure, 360.0 - 2.0 * departure);
    path.quadTo(control, {0.0, 0.0});
    path.quadTo({-control.x, control.y}, {-right.x, right.y});
    path.close();
    return path;
}

Rect PinShape::extent() const {
    constexpr double kEdge = 2.0;
    constexpr double kBelow = 6.0;
    const double side = radius + kEdge;
    return {-side, -2.0 * radius - tip - kEdge, 2.0 * side, 2.0 * radius + tip + kEdge + kBelow};
}

void PinShape::drawShadow(Canvas& canvas) {
    // Its middle lies a little below the tip, which stands on its upper half.
    Path path;
    path.addEllipse({-9.0, -1.5, 18.0, 6.0});
    canvas.fill(path, Color::ofRole(ColorRole::PinShadow));
}

}  // namespace ktr::platform
