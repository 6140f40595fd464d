#include "platform/map/MapAnnotation.h"

#include <utility>

namespace ktr::platform {

MapAnnotation::~MapAnnotation() = default;

std::shared_ptr<void> MapAnnotation::observeCoordinate(std::function<void()> changed) {
    auto observer = std::make_shared<std::function<void()>>(std::move(changed));
    observers_.push_back(observer);
    return observer;
}

void MapAnnotation::coordinateChanged() {
    std::erase_if(observers_, [](const auto& observer) { return observer.expired(); });
    const auto observers = observers_;
    for (const auto& observer : observers) {
        if (const auto changed = observer.lock()) {
            (*changed)();
        }
    }
}

void UserLocation::setLocation(std::shared_ptr<PlatformLocation> location, const Coordinate& onMap) {
    location_ = std::move(location);
    coordinate_ = onMap;
    coordinateChanged();
}

}  // namespace ktr::platform
