#include "linux/positions/SourceLocationManager.h"

namespace ktr::linux_ {

SourceLocationManager::~SourceLocationManager() {
    if (updating_) {
        hub_->forgetMissing();
    }
}

void SourceLocationManager::setDesiredAccuracy(double metres) {
    desiredAccuracy_ = metres;
    if (updating_) {
        hub_->retune();
    }
}

void SourceLocationManager::startUpdatingLocation() {
    if (updating_) {
        return;
    }
    updating_ = true;
    lastDelivered_ = nullptr;
    ++round_;
    hub_->setWanted(platform::strong(this), true);
    if (hub_->newest()) {
        hub_->mainLoop().post([self = platform::weak(this), round = round_] {
            const auto manager = self.lock();
            // A newer position may have come first.
            if (manager && manager->updating_ && manager->round_ == round && !manager->lastDelivered_) {
                manager->receive(manager->hub_->newest());
            }
        });
    }
}

void SourceLocationManager::stopUpdatingLocation() {
    if (updating_) {
        updating_ = false;
        hub_->setWanted(platform::strong(this), false);
    }
}

void SourceLocationManager::receive(const std::shared_ptr<platform::PlatformLocation>& position) {
    if (!updating_) {
        return;
    }
    if (lastDelivered_ &&
        hub_->geodesy().distance(lastDelivered_->coordinate(), position->coordinate()) < distanceFilter_) {
        return;
    }
    lastDelivered_ = position;
    if (const auto told = delegate()) {
        told->didUpdateLocations(*this, {position});
    }
}

}  // namespace ktr::linux_
