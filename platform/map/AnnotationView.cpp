#include "platform/map/AnnotationView.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "platform/map/PinShape.h"
#include "platform/ui/Canvas.h"

namespace ktr::platform {

bool AnnotationView::initWithAnnotation(const std::shared_ptr<MapAnnotation>& annotation,
                                        const std::string& reuseIdentifier) {
    if (!View::initWithFrame({})) {
        return false;
    }
    annotation_ = annotation;
    reuseIdentifier_ = reuseIdentifier;
    return true;
}

void AnnotationView::setAnnotation(std::shared_ptr<MapAnnotation> annotation) {
    if (annotation != annotation_) {
        annotation_ = std::move(annotation);
        annotationChanged();
        setNeedsDisplay();
    }
}

void AnnotationView::prepareForMap(const Size& /*mapSize*/, double /*pointsPerMetre*/) {}

void AnnotationView::setExtent(const Size& size, Point anchor) {
    // The anchor keeps its place on the map.
    const Rect& old = frame();
    const Point at{old.x + anchorPoint_.x, old.y + anchorPoint_.y};
    anchorPoint_ = anchor;
    setFrame({at.x - anchor.x, at.y - anchor.y, size.width, size.height});
}

namespace {

/// A disc of 40 and its edge; the tip is 8 long.
constexpr PinShape kMarker{20.75, 8.0, 27.0};
constexpr double kDot = 14.0;
constexpr double kDotRim = 20.0;
constexpr double kHalo = 40.0;

/// Six dashes around a dot.
void drawFenceIcon(Canvas& canvas, Point middle) {
    constexpr double kRadius = 8.2;
    constexpr int kDashes = 6;
    constexpr double kTurned = -19.0;  // degrees
    constexpr double kDash = 5.4 / (5.4 + 3.187) * 360.0 / kDashes;
    const Color white = Color::white(1.0, 1.0);
    for (int i = 0; i < kDashes; ++i) {
        Path dash;
        dash.addArc(middle, kRadius, kTurned + i * 360.0 / kDashes, kDash);
        canvas.stroke(dash, white, {2.3, false});
    }
    Path dot;
    dot.addCircle(middle, 3.2);
    canvas.fill(dot, white);
}

}  // namespace

bool MarkerAnnotationView::initWithAnnotation(const std::shared_ptr<MapAnnotation>& annotation,
                                              const std::string& reuseIdentifier) {
    if (!AnnotationView::initWithAnnotation(annotation, reuseIdentifier)) {
        return false;
    }
    const Rect extent = kMarker.extent();
    setExtent(extent.size(), {-extent.x, -extent.y});
    return true;
}

void MarkerAnnotationView::setMarkerTintColor(const Color& color) {
    markerTintColor_ = color;
    setNeedsDisplay();
}

void MarkerAnnotationView::draw(Canvas& canvas) const {
    if (!drawsAnnotation()) {
        return;
    }
    canvas.save();
    canvas.translate(anchorPoint().x, anchorPoint().y);
    PinShape::drawShadow(canvas);
    const Path outline = kMarker.outline();
    canvas.fill(outline, markerTintColor_);
    canvas.stroke(outline, Color::ofRole(ColorRole::MarkerPinEdge), {1.0, false});
    drawFenceIcon(canvas, kMarker.centre());
    canvas.restore();
}

void UserLocationView::prepareForMap(const Size& mapSize, double pointsPerMetre) {
    const auto user = std::dynamic_pointer_cast<UserLocation>(annotation());
    const auto& location = user ? user->location() : nullptr;
    const double sure = location ? location->fix().horizontalAccuracy * pointsPerMetre : 0.0;
    // Larger than any map is large enough: a position known to the country covers all of it.
    const double most = mapSize.width + mapSize.height;
    const double radius = std::clamp(std::isfinite(sure) ? sure : 0.0, kHalo / 2.0, std::max(most, kHalo / 2.0));
    setExtent({2.0 * radius, 2.0 * radius}, {radius, radius});
}

Rect UserLocationView::opaqueRect() const {
    const Point middle = anchorPoint();
    return {middle.x - kDotRim / 2.0, middle.y - kDotRim / 2.0, kDotRim, kDotRim};
}

void UserLocationView::draw(Canvas& canvas) const {
    if (!drawsAnnotation()) {
        return;
    }
    const Point middle = anchorPoint();
    const auto disc = [&](double diameter, const Color& color, double dy = 0.0) {
        Path path;
        path.addCircle({middle.x, middle.y + dy}, diameter / 2.0);
        canvas.fill(path, color);
    };
    disc(frame().width, Color::ofRole(ColorRole::MapUserHalo));
    // A soft shadow: rings that fade outwards.
    for (const double wider : {3.0, 2.0, 1.0}) {
        disc(kDotRim + wider, Color::rgb(43.0 / 255.0, 26.0 / 255.0, 5.0 / 255.0, 0.1), 0.75);
    }
    disc(kDotRim, Color::white(1.0, 1.0));
    disc(kDot, Color::rgb(30.0 / 255.0, 122.0 / 255.0, 98.0 / 255.0));
}

}  // namespace ktr::platform
