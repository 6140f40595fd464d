#include "platform/map/KTAnnotationView.h"

#include "platform/base/Platform.h"
#include "platform/map/PinShape.h"
#include "platform/ui/Canvas.h"

namespace ktr::platform {

namespace {

struct ClassSettings {
    static std::shared_ptr<ClassSettings> makeShared() { return std::make_shared<ClassSettings>(); }
    bool isBorderVisible = true;
    bool isMasking = false;
};

/// Maps from here on have room for a large pin; points.
constexpr double kLargeMapHeight = 300.0;

}  // namespace

struct KTAnnotationView::Measures {
    double disc = 56.0;   ///< diameter
    double border = 0.0;  ///< white, around the disc
    double ring = 4.0;    ///< of the tint, around the border
    double tip = 10.0;
    PinShape shape() const { return {disc / 2.0 + border + ring + 0.75, tip, 25.0}; }
};

bool KTAnnotationView::isLargeAnnotationBorderVisible() {
    const auto settings = shared<ClassSettings>();
    return !settings || settings->isBorderVisible;
}

void KTAnnotationView::setLargeAnnotationBorderVisible(bool visible) {
    if (const auto settings = shared<ClassSettings>()) {
        settings->isBorderVisible = visible;
    }
}

bool KTAnnotationView::isLayerMaskingEnabled() {
    const auto settings = shared<ClassSettings>();
    return settings && settings->isMasking;
}

void KTAnnotationView::setLayerMaskingEnabled(bool enabled) {
    if (const auto settings = shared<ClassSettings>()) {
        settings->isMasking = enabled;
    }
}

bool KTAnnotationView::initWithAnnotation(const std::shared_ptr<MapAnnotation>& annotation,
                                          const std::string& reuseIdentifier, const Color& tintColor) {
    if (!AnnotationView::initWithAnnotation(annotation, reuseIdentifier)) {
        return false;
    }
    tintColor_ = tintColor;
    layOutPin();
    return true;
}

void KTAnnotationView::prepareForMap(const Size& mapSize, double /*pointsPerMetre*/) {
    isLarge_ = mapSize.height >= kLargeMapHeight;
    layOutPin();
}

KTAnnotationView::Measures KTAnnotationView::measures() const {
    const auto pin = std::dynamic_pointer_cast<KTAnnotation>(annotation());
    Measures m;
    if (isLarge_) {
        m = {89.0, 0.0, 6.0, 15.0};
    }
    if (isLargeAnnotationBorderVisible() || (pin && pin->isBorderEnabled())) {
        m.border = isLarge_ ? 3.0 : 2.0;
    }
    return m;
}

void KTAnnotationView::layOutPin() {
    const Rect extent = measures().shape().extent();
    setExtent(extent.size(), {-extent.x, -extent.y});
    setNeedsDisplay();
}

void KTAnnotationView::draw(Canvas& canvas) const {
    const auto pin = std::dynamic_pointer_cast<KTAnnotation>(annotation());
    if (!pin || !drawsAnnotation() || pin->isThisDevice()) {
        return;
    }
    const Measures m = measures();
    const PinShape shape = m.shape();
    canvas.save();
    canvas.translate(anchorPoint().x, anchorPoint().y);
    PinShape::drawShadow(canvas);
    const Path outline = shape.outline();
    canvas.fill(outline, pin->tintColor().value_or(tintColor_));
    canvas.stroke(outline, Color::ofRole(ColorRole::FriendPinEdge), {1.0, false});
    if (m.border > 0.0) {
        Path border;
        border.addCircle(shape.centre(), m.disc / 2.0 + m.border);
        canvas.fill(border, Color::white(1.0, 1.0));
    }
    drawIcon(canvas, *pin, {-m.disc / 2.0, shape.centre().y - m.disc / 2.0, m.disc, m.disc});
    canvas.restore();
}

void KTAnnotationView::drawIcon(Canvas& canvas, const KTAnnotation& annotation, const Rect& disc) const {
    const auto large = annotation.largeAnnotationIcon();
    const auto icon = large ? large : annotation.smallAnnotationIcon();
    if (icon) {
        canvas.save();
        if (isLayerMaskingEnabled()) {
            Path mask;
            mask.addEllipse(disc);
            canvas.clip(mask);
        }
        canvas.draw(*icon, disc);
        canvas.restore();
    }
    const auto largeOverlay = annotation.largeOverlayIcon();
    if (const auto overlay = largeOverlay ? largeOverlay : annotation.smallOverlayIcon()) {
        const Size size = overlay->size();
        canvas.draw(*overlay, {disc.maxX() - size.width, disc.maxY() - size.height, size.width, size.height});
    }
}

}  // namespace ktr::platform
