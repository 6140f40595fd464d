#include "views/KTRVAMapDelegate.h"

#include "model/KTRVATheme.h"
#include "platform/base/Platform.h"
#include "platform/map/KTAnnotationView.h"
#include "views/KTRVAMapAnnotation.h"

namespace ktr {

using platform::AnnotationView;
using platform::create;
using platform::KTAnnotationView;
using platform::MarkerAnnotationView;

namespace {

constexpr double kCircleAlpha = 0.2;

std::shared_ptr<AnnotationView> makeView(const std::shared_ptr<KTRVAMapAnnotation>& annotation) {
    if (annotation->isFenceAnnotation()) {
        auto marker = create<MarkerAnnotationView>(&MarkerAnnotationView::initWithAnnotation, annotation,
                                                   KTRVAMapDelegate::kReuseIdentifier);
        marker->setMarkerTintColor(platform::Color::systemRed());
        return marker;
    }
    using Initialiser = bool (KTAnnotationView::*)(const std::shared_ptr<platform::MapAnnotation>&, const std::string&,
                                                   const platform::Color&);
    return create<KTAnnotationView>(static_cast<Initialiser>(&KTAnnotationView::initWithAnnotation), annotation,
                                    KTRVAMapDelegate::kReuseIdentifier, KTRVATheme::ktrOrangeColor());
}

}  // namespace

std::shared_ptr<KTRVAMapDelegate> KTRVAMapDelegate::sharedInstance() {
    return platform::shared<KTRVAMapDelegate>();
}

std::shared_ptr<AnnotationView> KTRVAMapDelegate::viewForAnnotation(
    platform::PlatformMapView& map, const std::shared_ptr<platform::MapAnnotation>& annotation) {
    const auto pin = std::dynamic_pointer_cast<KTRVAMapAnnotation>(annotation);
    if (!pin) {
        return nullptr;
    }
    auto view = map.dequeueReusableAnnotationView(kReuseIdentifier);
    if (!view) {
        view = makeView(pin);
    }
    view->setAnnotation(pin);
    view->setCanShowCallout(false);
    view->setEnabled(false);
    return view;
}

std::shared_ptr<platform::MapOverlayRenderer> KTRVAMapDelegate::rendererForOverlay(
    platform::PlatformMapView& /*map*/, const std::shared_ptr<platform::MapOverlay>& overlay) {
    const auto circle = std::dynamic_pointer_cast<platform::CircleOverlay>(overlay);
    if (!circle) {
        return nullptr;
    }
    auto renderer = std::make_shared<platform::CircleOverlayRenderer>(circle);
    renderer->setFillColor(KTRVATheme::ktrOrangeColor());
    renderer->setAlpha(kCircleAlpha);
    return renderer;
}

}  // namespace ktr
