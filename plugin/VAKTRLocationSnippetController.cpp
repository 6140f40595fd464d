#include "plugin/VAKTRLocationSnippetController.h"

#include <algorithm>
#include <iterator>

#include "service/ContextValues.h"
#include "service/KTRVAUtils.h"

namespace ktr {

using platform::create;
using platform::Rect;

namespace {

/// Degrees; single precision like what a context says, and not rounded back.
constexpr double kUsualZoom = 0.05f;
/// Beside the map, while there is no row to measure; points.
constexpr double kHeightOfNoRow = 90.0;

bool hasCoordinate(const std::shared_ptr<KTRVALocation>& record) {
    return record->hasCoordinate();
}

}  // namespace

bool VAKTRLocationSnippetController::initWithCueObject(const std::shared_ptr<platform::VASnippet>& snippet) {
    if (!VAKTRBaseSnippetController::initWithCueObject(snippet)) {
        return false;
    }
    if (const auto& context = contextDict()) {
        displayShowAllRow_ = ContextValues::boolean(*context, "incomplete");
        zoomLevel_ = context->find("zoomLevel") != nullptr
                         ? static_cast<double>(ContextValues::singleNumber(*context, "zoomLevel"))
                         : kUsualZoom;
    }
    return true;
}

void VAKTRLocationSnippetController::loadView() {
    VAKTRBaseSnippetController::loadView();
    axSize_ = KTRVelaBaseView::accessibilitySizeIsActive();
    friendView_ = makeFriendRow(axSize_);
    friendView_->setViewDelegate(platform::weak(this));
    friendView_->setUrlHandler(platform::weak(this));
    friendView_->setCurrentLocationDelegate(refreshController());
    friendView_->setLocation(disambiguatedLocation());

    const Rect mapFrame{0.0, 0.0, currentWidth(), KTRDynVelaMapView::mapHeight()};
    mapView_ = create<KTRDynVelaMapView>(&KTRDynVelaMapView::initWithFrame, mapFrame);
    mapView_->setUrlHandler(platform::weak(this));
    mapView_->setCurrentLocationDelegate(refreshController());
    mapView_->setLocation(disambiguatedLocation());
    mapView_->setZoomLevel(zoomLevel_);

    mapView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    containerView()->addArrangedSubview(friendView_);
    containerView()->addArrangedSubview(mapView_);
}

void VAKTRLocationSnippetController::showLocation() {
    const auto location = disambiguatedLocation();
    if (friendView_) {
        friendView_->setLocation(location);
    }
    if (mapView_) {
        mapView_->setLocation(location);
    }
}

void VAKTRLocationSnippetController::reloadData() {
    VAKTRBaseSnippetController::reloadData();
    showLocation();
}

void VAKTRLocationSnippetController::refreshCancelled() {
    // The flag is read, not set, and what it says changes nothing.
    static_cast<void>(refreshingCancelled());
    if (friendView_) {
        friendView_->setIsRefreshingLocation(false);
    }
    showLocation();
}

double VAKTRLocationSnippetController::desiredHeightForWidth(double width) {
    setCurrentWidth(width);
    if (!containerView()) {
        loadView();
    }
    if (containerView()->window()) {
        containerView()->layoutIfNeeded();
    }
    const double map = KTRDynVelaMapView::mapHeight();
    const double height = (friendView_ ? friendView_->estimagedHeightForView() : 0.0) + map;
    return height == 0.0 ? map + kHeightOfNoRow : height;
}

namespace {

/// Whether the row shows a place, or the map does: words are a place, and so is one on the equator or on the zeroth
/// meridian; where both meet is none.
bool isFound(const KTRVALocation& record) {
    const auto& object = record.velaLocation();
    if (!object) {
        return false;
    }
    return object->label || object->city || object->stateCode ||
           (record.hasCoordinate() && (*object->latitude != 0.0 || *object->longitude != 0.0));
}

}  // namespace

bool VAKTRLocationSnippetController::isSearching() const {
    const auto record = disambiguatedLocation();
    return record && friendView_ && friendView_->isRefreshingLocation() && !isFound(*record);
}

bool VAKTRLocationSnippetController::allEmptyLocations() const {
    return std::none_of(locations().begin(), locations().end(), hasCoordinate);
}

bool VAKTRLocationSnippetController::showLocatingFriends() const {
    return proximity().has_value() && allEmptyLocations();
}

VAKTRBaseSnippetController::Locations VAKTRLocationSnippetController::proximityLocationsWithCoordinates() const {
    Locations known;
    std::copy_if(locations().begin(), locations().end(), std::back_inserter(known), hasCoordinate);
    return known;
}

}  // namespace ktr
