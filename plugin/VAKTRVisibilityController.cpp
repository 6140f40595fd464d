#include "plugin/VAKTRVisibilityController.h"

#include <utility>

#include "model/LogCategory.h"
#include "model/PluginBundle.h"
#include "service/ContextValues.h"

namespace ktr {

using platform::create;
using platform::Rect;

namespace {

/// Beside the map, while there is nothing to measure; points.
constexpr double kHeightOfNoRow = 90.0;

/// The user's record at the end of a result, or none.
std::shared_ptr<KTRVAMyLocation> lastRecord(const std::shared_ptr<const ServiceResult>& result) {
    if (!result || result->empty()) {
        return nullptr;
    }
    const auto* record = std::get_if<std::shared_ptr<KTRVAMyLocation>>(&result->back());
    return record != nullptr ? *record : nullptr;
}

}  // namespace

bool VAKTRVisibilityController::initWithCueObject(const std::shared_ptr<platform::VASnippet>& snippet) {
    if (!VAKTRBaseSnippetController::initWithCueObject(snippet)) {
        return false;
    }
    const auto view = std::dynamic_pointer_cast<platform::VAKtrVisibilityView>(snippet);
    isVisible_ = view && view->visible;
    LogCategory_Unspecified()->line("is visible init called: %d", isVisible_);
    const auto& context = contextDict();
    const std::shared_ptr<platform::VAKtrLocation> noPlace;
    myLocation_ = KTRVAMyLocation::myLocation(isVisible_, noPlace,
                                              context ? ContextValues::text(*context, "preferredEmail") : std::nullopt);
    return true;
}

void VAKTRVisibilityController::setDelegate(const std::shared_ptr<platform::SnippetHostDelegate>& delegate) {
    // A host may drop the controller while it is being asked.
    const auto self = platform::strong(this);
    VAKTRBaseSnippetController::setDelegate(delegate);
    if (delegate && isVisible_) {
        refreshController()->setIsVisibilityRefresh(true);
    }
}

void VAKTRVisibilityController::loadView() {
    VAKTRBaseSnippetController::loadView();
    // No view delegate: whatever this row says of its size does not reach the host.
    friendView_ = makeFriendRow(KTRVelaBaseView::accessibilitySizeIsActive());
    friendView_->setIsVisibility(true);
    friendView_->setUrlHandler(platform::weak(this));
    friendView_->setCurrentLocationDelegate(refreshController());
    friendView_->setLocation(myLocation_);
    containerView()->addArrangedSubview(friendView_);
    if (!isVisible_) {
        // There is nothing below the row to part it from.
        friendView_->setSeparatorEnabled(false);
        return;
    }
    // Seen, the map says that the place is shared; a hidden user's row says so itself.
    friendView_->setAccessibilityLabel(AssistantLocalizedString("ACCESSIBILITY_SHARED_LOCATION"));
    const Rect mapFrame{0.0, 0.0, currentWidth(), KTRDynVelaMapView::mapHeight()};
    mapView_ = create<KTRDynVelaMapView>(&KTRDynVelaMapView::initWithFrame, mapFrame);
    mapView_->setIsVisibilityMap(true);
    mapView_->setUrlHandler(platform::weak(this));
    mapView_->setCurrentLocationDelegate(refreshController());
    mapView_->setLocation(myLocation_);
    mapView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    containerView()->addArrangedSubview(mapView_);
}

void VAKTRVisibilityController::showMyLocation() {
    if (friendView_) {
        friendView_->setLocation(myLocation_);
    }
    if (mapView_) {
        // The map shows where the user is by itself; from here on its link has no handle.
        mapView_->setLocation(nullptr);
    }
}

void VAKTRVisibilityController::reloadData() {
    VAKTRBaseSnippetController::reloadData();
    showMyLocation();
}

void VAKTRVisibilityController::locationsUpdated(const std::shared_ptr<const ServiceResult>& result) {
    if (isVisible_) {
        auto record = lastRecord(result);
        LogCategory_Unspecified()->line("visibility_vela_location: %@", record);
        myLocation_ = std::move(record);
        showMyLocation();
    }
    VAKTRBaseSnippetController::locationsUpdated(result);
}

void VAKTRVisibilityController::refreshCancelled() {
    // The flag is read, not set, and what it says changes nothing.
    static_cast<void>(refreshingCancelled());
    reloadData();
}

std::vector<std::shared_ptr<platform::VAPerson>> VAKTRVisibilityController::friends() const {
    const auto object = myLocation_ ? myLocation_->velaLocation() : nullptr;
    if (!object || !object->friend_ || !object->friend_->object) {
        return {};
    }
    return {object->friend_->object};
}

bool VAKTRVisibilityController::isSearching() const {
    const auto refresher = refreshController();
    const bool known = myLocation_ && myLocation_->hasCoordinate();
    return isVisible_ && !known && refresher && !refresher->refresherCancelled();
}

double VAKTRVisibilityController::desiredHeightForWidth(double width) {
    setCurrentWidth(width);
    if (!containerView()) {
        loadView();
    }
    if (containerView()->window()) {
        containerView()->layoutIfNeeded();
    }
    const double map = KTRDynVelaMapView::mapHeight();
    const double height = (friendView_ ? friendView_->estimagedHeightForView() : 0.0) + (isVisible_ ? map : 0.0);
    return height == 0.0 ? map + kHeightOfNoRow : height;
}

}  // namespace ktr
