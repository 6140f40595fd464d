#include "platform/map/MapUserTracker.h"

#include <utility>

namespace ktr::platform {

MapUserTracker::MapUserTracker(Moved moved) : moved_(std::move(moved)) {}

MapUserTracker::~MapUserTracker() {
    if (manager_) {
        manager_->stopUpdatingLocation();
    }
}

void MapUserTracker::start(const std::shared_ptr<PlatformLocationManager>& manager) {
    manager_ = manager;
    manager->setDelegate(weak_from_this());
    manager->setDesiredAccuracy(kLocationAccuracyNearestTenMeters);
    manager->setDistanceFilter(1.0);
    manager->startUpdatingLocation();
    catchUp();
}

void MapUserTracker::catchUp() {
    tell(manager_ ? manager_->location() : nullptr);
}

void MapUserTracker::didUpdateLocations(PlatformLocationManager&, const PlatformLocations& locations) {
    if (!locations.empty()) {
        tell(locations.back());
    }
}

void MapUserTracker::tell(const std::shared_ptr<PlatformLocation>& location) {
    // A negative accuracy marks a position that is none.
    if (location && location != told_ && isValid(location->coordinate()) && location->fix().horizontalAccuracy >= 0.0) {
        told_ = location;
        moved_(location);
    }
}

}  // namespace ktr::platform
