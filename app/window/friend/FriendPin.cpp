#include "app/window/friend/FriendPin.h"

namespace ktr::app {

using namespace platform;

namespace {

constexpr double kCircleAlpha = 0.2;
const Color kOrange = Color::rgb(239.0 / 255.0, 143.0 / 255.0, 20.0 / 255.0);

}  // namespace

std::optional<Color> FriendPin::tintColor() const {
    return kOrange;
}

std::shared_ptr<AnnotationView> FriendPinDelegate::viewForAnnotation(PlatformMapView& /*map*/,
                                                                     const std::shared_ptr<MapAnnotation>& annotation) {
    // None for the user: the map has a dot of its own for them.
    return std::dynamic_pointer_cast<FriendPin>(annotation)
               ? create<KTAnnotationView>(
                     static_cast<bool (KTAnnotationView::*)(const std::shared_ptr<MapAnnotation>&, const std::string&,
                                                            const Color&)>(&KTAnnotationView::initWithAnnotation),
                     annotation, "friend", kOrange)
               : nullptr;
}

std::shared_ptr<MapOverlayRenderer> FriendPinDelegate::rendererForOverlay(PlatformMapView& /*map*/,
                                                                          const std::shared_ptr<MapOverlay>& overlay) {
    const auto circle = std::dynamic_pointer_cast<CircleOverlay>(overlay);
    if (!circle) {
        return nullptr;
    }
    auto renderer = std::make_shared<CircleOverlayRenderer>(circle);
    renderer->setFillColor(kOrange);
    renderer->setAlpha(kCircleAlpha);
    return renderer;
}

}  // namespace ktr::app
