#include "plugin/VAKTRGeoFenceSnippetController.h"

#include "service/ContextValues.h"
#include "views/accessibility/KTRAXVelaFenceView.h"

namespace ktr {

using platform::create;
using platform::Rect;

namespace {

/// Degrees; single precision like what a context says, and not rounded back.
constexpr double kUsualZoom = 0.0008f;
/// The row's height before it is laid out; points.
constexpr double kRowHeight = 100.0;
/// Beside the map, while there is nothing to measure; points.
constexpr double kHeightOfNoRow = 90.0;

}  // namespace

bool VAKTRGeoFenceSnippetController::initWithCueObject(const std::shared_ptr<platform::VASnippet>& snippet) {
    if (!VAKTRBaseSnippetController::initWithCueObject(snippet)) {
        return false;
    }
    if (const auto fenced = std::dynamic_pointer_cast<platform::VAKtrGeoFenceSnippet>(snippet)) {
        cueKtrGeoFence_ = fenced->cueKtrGeoFence;
    }
    if (const auto& context = contextDict()) {
        zoomLevel_ = context->find("geoFenceZoomLevel") != nullptr
                         ? static_cast<double>(ContextValues::singleNumber(*context, "geoFenceZoomLevel"))
                         : kUsualZoom;
    }
    return true;
}

void VAKTRGeoFenceSnippetController::loadView() {
    VAKTRBaseSnippetController::loadView();
    if (KTRVelaBaseView::accessibilitySizeIsActive()) {
        fenceView_ =
            create<KTRAXVelaFenceView>(&KTRAXVelaFenceView::initWithFrame, Rect{0.0, 0.0, currentWidth(), 0.0});
    } else {
        const Rect frame{0.0, 0.0, currentWidth(), kRowHeight};
        fenceView_ = create<KTRVelaFenceView>(&KTRVelaFenceView::initWithFrame, frame);
    }
    fenceView_->setViewDelegate(platform::weak(this));
    fenceView_->setUrlHandler(platform::weak(this));
    fenceView_->setCurrentLocationDelegate(refreshController());
    fenceView_->setGeoFence(cueKtrGeoFence_);

    // Unlike other maps this one is not told where the user is: a fence's region does not depend on it.
    const Rect mapFrame{0.0, 0.0, currentWidth(), KTRDynVelaMapView::mapHeight()};
    mapView_ = create<KTRDynVelaMapView>(&KTRDynVelaMapView::initWithFrame, mapFrame);
    mapView_->setUrlHandler(platform::weak(this));
    // The fence is drawn as soon as it is set, and needs the zoom then.
    mapView_->setZoomLevel(zoomLevel_);
    mapView_->setGeoFence(cueKtrGeoFence_);

    fenceView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    mapView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    containerView()->addArrangedSubview(fenceView_);
    containerView()->addArrangedSubview(mapView_);
}

double VAKTRGeoFenceSnippetController::desiredHeightForWidth(double width) {
    setCurrentWidth(width);
    // Deliberately without loading the view.
    if (containerView() && containerView()->window()) {
        containerView()->layoutIfNeeded();
    }
    const double map = KTRDynVelaMapView::mapHeight();
    const double height = (fenceView_ ? fenceView_->estimagedHeightForView() : 0.0) + map;
    return height == 0.0 ? map + kHeightOfNoRow : height;
}

}  // namespace ktr
