#include "service/RefreshController.h"

#include "platform/base/Assert.h"
#include "platform/base/NotificationCenter.h"
#include "platform/base/Platform.h"

namespace ktr {

namespace {
/// Metres: the distance filter, and the shortest move that is told of.
constexpr double kDistanceOfNote = 10.0;
}  // namespace

RefreshController::~RefreshController() {
    if (locationManager_) {
        locationManager_->stopUpdatingLocation();
    }
}

bool RefreshController::initWithBundle(const std::shared_ptr<platform::Bundle>& bundle) {
    KTR_ASSERT_MAIN_THREAD();
    locationManager_ = platform::Platform::installed()->locationManagers->makeManager(bundle);
    locationManager_->setDelegate(platform::weak(this));
    locationManager_->setDesiredAccuracy(platform::kLocationAccuracyNearestTenMeters);
    locationManager_->setDistanceFilter(kDistanceOfNote);
    locationManager_->startUpdatingLocation();
    currentLocation_ = locationManager_->location();
    return true;
}

void RefreshController::didUpdateLocations(platform::PlatformLocationManager& /*manager*/,
                                           const platform::PlatformLocations& locations) {
    KTR_ASSERT_MAIN_THREAD();
    if (locations.empty() || !locations.back()) {
        return;
    }
    const auto previous = std::move(currentLocation_);
    currentLocation_ = locations.back();
    const double metres = previous ? currentLocation_->distanceFromLocation(*previous) : 0.0;
    const auto installed = platform::Platform::installed();
    if (metres > kDistanceOfNote && installed) {
        installed->notificationCenter->post({kCurrentLocationUpdatedNotification, platform::strong(this)});
    }
}

}  // namespace ktr
