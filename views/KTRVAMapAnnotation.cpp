#include "views/KTRVAMapAnnotation.h"

#include <utility>

#include "platform/ui/Animation.h"

namespace ktr {

namespace {

constexpr double kGlide = 0.5;  // seconds

}  // namespace

std::shared_ptr<KTRVAMapAnnotation> KTRVAMapAnnotation::annotationWithLocation(
    const std::shared_ptr<platform::VALocation>& location) {
    auto annotation = std::make_shared<KTRVAMapAnnotation>();
    annotation->setLocation(location);
    return annotation;
}

KTRVAMapAnnotation::~KTRVAMapAnnotation() {
    setLocation(nullptr);
}

void KTRVAMapAnnotation::setLocation(std::shared_ptr<platform::VALocation> location) {
    if (location != location_) {
        location_ = std::move(location);
    }
    platform::Animation::animate(kGlide, [this] { updateCoordinateForLocation(location_); });
}

void KTRVAMapAnnotation::updateCoordinateForLocation(const std::shared_ptr<platform::VALocation>& location) {
    setCoordinate(location ? platform::Coordinate{location->latitude.value_or(0.0), location->longitude.value_or(0.0)}
                           : platform::Coordinate{});
}

void KTRVAMapAnnotation::setCoordinate(const platform::Coordinate& coordinate) {
    coordinate_ = coordinate;
    coordinateChanged();
}

bool KTRVAMapAnnotation::hasKnownLocation() const {
    return location_ && location_->latitude.value_or(0.0) != 0.0 && location_->longitude.value_or(0.0) != 0.0;
}

}  // namespace ktr
