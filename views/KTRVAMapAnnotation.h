#pragma once

#include <memory>
#include <optional>

#include "platform/assistant/VALocation.h"
#include "platform/map/KTAnnotationView.h"

namespace ktr {

/// The one pin of a snippet's map: a friend, or a fence. Main thread.
class KTRVAMapAnnotation : public platform::KTAnnotation {
  public:
    static std::shared_ptr<KTRVAMapAnnotation> annotationWithLocation(
        const std::shared_ptr<platform::VALocation>& location);
    /// Lets go of the location first, as of a pin that goes.
    ~KTRVAMapAnnotation() override;

    /// May be none. A pin that is on a map already glides to the place for half a second, also when the location is the
    /// one that it has.
    const std::shared_ptr<platform::VALocation>& location() const { return location_; }
    void setLocation(std::shared_ptr<platform::VALocation> location);
    /// The location's degrees; 0 for what is missing.
    void updateCoordinateForLocation(const std::shared_ptr<platform::VALocation>& location);
    platform::Coordinate coordinate() const override { return coordinate_; }
    void setCoordinate(const platform::Coordinate& coordinate);
    /// Whether latitude and longitude are both known and neither is 0: a place on the equator or the prime meridian
    /// counts as unknown.
    bool hasKnownLocation() const override;
    /// Never: the pin is not drawn as the user's own device.
    bool isThisDevice() const override { return false; }

    /// The pin marks a fence, not a friend.
    bool isFenceAnnotation() const { return isFenceAnnotation_; }
    void setIsFenceAnnotation(bool isFence) { isFenceAnnotation_ = isFence; }
    /// Set for a friend without a photo.
    bool isBorderEnabled() const override { return isBorderEnabled_; }
    void setIsBorderEnabled(bool enabled) { isBorderEnabled_ = enabled; }
    std::shared_ptr<platform::Image> largeOverlayIcon() const override { return largeOverlayIcon_; }
    void setLargeOverlayIcon(std::shared_ptr<platform::Image> icon) { largeOverlayIcon_ = std::move(icon); }
    std::shared_ptr<platform::Image> smallOverlayIcon() const override { return smallOverlayIcon_; }
    void setSmallOverlayIcon(std::shared_ptr<platform::Image> icon) { smallOverlayIcon_ = std::move(icon); }
    /// Metres; the plugin leaves it at 0.
    double distanceFromUser() const override { return distanceFromUser_; }
    void setDistanceFromUser(double metres) { distanceFromUser_ = metres; }
    std::shared_ptr<platform::KTAccuracyOverlay> overlay() const override { return overlay_; }
    void setOverlay(std::shared_ptr<platform::KTAccuracyOverlay> overlay) { overlay_ = std::move(overlay); }
    /// Metres; the plugin leaves it at 0.
    double horizontalAccuracy() const override { return horizontalAccuracy_; }
    void setHorizontalAccuracy(double metres) { horizontalAccuracy_ = metres; }
    std::optional<platform::Color> tintColor() const override { return tintColor_; }
    void setTintColor(std::optional<platform::Color> color) { tintColor_ = color; }
    /// The friend's monogram, in both sizes.
    std::shared_ptr<platform::Image> largeAnnotationIcon() const override { return largeAnnotationIcon_; }
    void setLargeAnnotationIcon(std::shared_ptr<platform::Image> icon) { largeAnnotationIcon_ = std::move(icon); }
    std::shared_ptr<platform::Image> smallAnnotationIcon() const override { return smallAnnotationIcon_; }
    void setSmallAnnotationIcon(std::shared_ptr<platform::Image> icon) { smallAnnotationIcon_ = std::move(icon); }

  private:
    bool isFenceAnnotation_ = false;
    bool isBorderEnabled_ = false;
    std::shared_ptr<platform::Image> largeOverlayIcon_;
    std::shared_ptr<platform::Image> smallOverlayIcon_;
    double distanceFromUser_ = 0.0;
    std::shared_ptr<platform::VALocation> location_;
    std::shared_ptr<platform::KTAccuracyOverlay> overlay_;
    double horizontalAccuracy_ = 0.0;
    std::optional<platform::Color> tintColor_;
    std::shared_ptr<platform::Image> largeAnnotationIcon_;
    std::shared_ptr<platform::Image> smallAnnotationIcon_;
    platform::Coordinate coordinate_;
};

}  // namespace ktr
