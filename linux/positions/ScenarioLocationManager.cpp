#include "linux/positions/ScenarioLocationManager.h"

#include <algorithm>

namespace ktr::linux_ {

ScenarioLocationManager::~ScenarioLocationManager() {
    if (timer_) {
        timer_->invalidate();
    }
}

void ScenarioLocationManager::setDesiredAccuracy(double) {}

double ScenarioLocationManager::elapsed() const {
    return walk_->clock->now().secondsSinceReferenceDate - walk_->start.secondsSinceReferenceDate;
}

std::size_t ScenarioLocationManager::known() const {
    const double now = std::max(elapsed(), 0.0);
    const auto& positions = walk_->positions;
    const auto later = std::upper_bound(positions.begin(), positions.end(), now,
                                        [](double time, const TimedPosition& p) { return time < p.seconds; });
    return static_cast<std::size_t>(later - positions.begin());
}

std::shared_ptr<platform::PlatformLocation> ScenarioLocationManager::positionAt(std::size_t index) const {
    if (!current_ || currentIndex_ != index) {
        current_ = std::make_shared<platform::PlatformLocation>(walk_->positions[index].fix);
        currentIndex_ = index;
    }
    return current_;
}

std::shared_ptr<platform::PlatformLocation> ScenarioLocationManager::location() const {
    const std::size_t count = known();
    return count == 0 ? nullptr : positionAt(count - 1);
}

void ScenarioLocationManager::startUpdatingLocation() {
    if (updating_) {
        return;
    }
    updating_ = true;
    lastDelivered_ = nullptr;
    const std::size_t count = known();
    if (count == 0) {
        scheduleNext(0);
        return;
    }
    timer_ = walk_->mainLoop->schedule(0.0, false, [self = platform::weak(this), index = count - 1] {
        if (const auto manager = self.lock()) {
            manager->reach(index);
        }
    });
}

void ScenarioLocationManager::stopUpdatingLocation() {
    updating_ = false;
    if (timer_) {
        timer_->invalidate();
        timer_ = nullptr;
    }
}

void ScenarioLocationManager::scheduleNext(std::size_t index) {
    if (index >= walk_->positions.size()) {
        return;
    }
    const double wait = walk_->positions[index].seconds - elapsed();
    timer_ = walk_->mainLoop->schedule(wait, false, [self = platform::weak(this), index] {
        if (const auto manager = self.lock()) {
            manager->reach(index);
        }
    });
}

void ScenarioLocationManager::reach(std::size_t index) {
    // The next one first: the delegate may stop the updates.
    scheduleNext(index + 1);
    deliver(positionAt(index));
}

void ScenarioLocationManager::deliver(const std::shared_ptr<platform::PlatformLocation>& position) {
    if (lastDelivered_ &&
        walk_->geodesy->distance(lastDelivered_->coordinate(), position->coordinate()) < distanceFilter_) {
        return;
    }
    lastDelivered_ = position;
    if (const auto told = delegate()) {
        told->didUpdateLocations(*this, {position});
    }
}

}  // namespace ktr::linux_
