#include "platform/map/CircleOverlay.h"

#include <cmath>

#include "platform/base/Platform.h"
#include "platform/location/Geodesy.h"
#include "platform/ui/Canvas.h"

namespace ktr::platform {

MapOverlay::~MapOverlay() = default;

Rect CircleOverlayRenderer::rectFor(const Coordinate& center, double radius, const MapViewport& viewport) {
    const auto installed = Platform::installed();
    if (!(radius > 0.0) || !std::isfinite(radius) || !isValid(center) || !installed || !installed->geodesy) {
        return {};
    }
    const auto& geodesy = *installed->geodesy;
    const Point middle = viewport.pointFor(center);
    // What lies on the other side of the world wraps around; the circle then covers all there is to see.
    const auto reach = [&](double azimuth, double whole) {
        constexpr double kQuarter = 1e7;  // metres, of the way round the world
        if (radius >= kQuarter) {
            return whole;
        }
        const Point there = viewport.pointFor(geodesy.destination(center, azimuth, radius));
        return std::hypot(there.x - middle.x, azimuth == 90.0 || azimuth == 270.0 ? 0.0 : there.y - middle.y);
    };
    const double whole = 2.0 * (viewport.size.width + viewport.size.height) + std::hypot(middle.x, middle.y);
    const double west = reach(270.0, whole);
    const double east = reach(90.0, whole);
    const double north = reach(0.0, whole);
    const double south = reach(180.0, whole);
    return {middle.x - west, middle.y - north, west + east, north + south};
}

void CircleOverlayRenderer::draw(Canvas& canvas, const MapViewport& viewport) const {
    const Rect rect = circle_ ? rectFor(circle_->coordinate(), circle_->radius(), viewport) : Rect{};
    const Rect visible{0.0, 0.0, viewport.size.width, viewport.size.height};
    if (!(rect.width > 0.0) || !rect.intersects(visible)) {
        return;
    }
    Path path;
    path.addEllipse(rect);
    const auto faded = [this](Color color) {
        color.alpha *= alpha();
        return color;
    };
    if (fillColor_) {
        canvas.fill(path, faded(*fillColor_));
    }
    if (strokeColor_ && lineWidth_ > 0.0) {
        canvas.stroke(path, faded(*strokeColor_), {lineWidth_, false});
    }
}

}  // namespace ktr::platform
