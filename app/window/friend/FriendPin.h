#pragma once

#include <memory>
#include <optional>

#include "platform/map/KTAnnotationView.h"
#include "platform/map/PlatformMapView.h"

namespace ktr::app {

/// A friend on the map of their own page. Main thread.
class FriendPin : public platform::KTAnnotation {
  public:
    struct Looks {
        std::shared_ptr<platform::Image> face;
        bool isPhoto = false;
    };

    explicit FriendPin(Looks looks) : looks_(std::move(looks)) {}

    /// In the datum of the map. A pin that is on a map glides there while an animation is made.
    void moveTo(const platform::Coordinate& place) {
        place_ = place;
        coordinateChanged();
    }
    platform::Coordinate coordinate() const override { return place_; }
    bool isBorderEnabled() const override { return !looks_.isPhoto; }
    std::shared_ptr<platform::Image> largeAnnotationIcon() const override { return looks_.face; }
    std::shared_ptr<platform::Image> smallAnnotationIcon() const override { return looks_.face; }
    std::shared_ptr<platform::Image> largeOverlayIcon() const override { return nullptr; }
    std::shared_ptr<platform::Image> smallOverlayIcon() const override { return nullptr; }
    std::optional<platform::Color> tintColor() const override;
    double distanceFromUser() const override { return 0.0; }
    double horizontalAccuracy() const override { return 0.0; }
    std::shared_ptr<platform::KTAccuracyOverlay> overlay() const override { return nullptr; }
    bool isThisDevice() const override { return false; }

  private:
    const Looks looks_;
    platform::Coordinate place_;
};

/// How that map draws pins and circles: as the answers' maps do. Main thread.
class FriendPinDelegate : public platform::PlatformMapViewDelegate {
  public:
    std::shared_ptr<platform::AnnotationView> viewForAnnotation(
        platform::PlatformMapView& map, const std::shared_ptr<platform::MapAnnotation>& annotation) override;
    std::shared_ptr<platform::MapOverlayRenderer> rendererForOverlay(
        platform::PlatformMapView& map, const std::shared_ptr<platform::MapOverlay>& overlay) override;
};

}  // namespace ktr::app
