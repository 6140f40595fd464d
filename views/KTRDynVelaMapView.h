#pragma once

#include <memory>
#include <optional>
#include <string>

#include "model/KTRVALocation.h"
#include "platform/assistant/VAKtrGeoFence.h"
#include "platform/base/NotificationCenter.h"
#include "platform/map/LocationShifter.h"
#include "platform/map/MapRegion.h"
#include "platform/map/PlatformMapView.h"
#include "views/CurrentLocationDelegate.h"
#include "views/KTRVAMapAnnotation.h"
#include "views/KTRVelaBaseView.h"

namespace ktr {

/// The map of a snippet: a friend and how sure their place is, or a fence, or the user. Its controller sets one of
/// `location`, `geoFence` and `isVisibilityMap`. Main thread.
class KTRDynVelaMapView : public KTRVelaBaseView {
  public:
    /// The frame's size is the map's: it is constrained to it.
    bool initWithFrame(const platform::Rect& frame) override;

    /// Shows the friend, at once or when the shifter has converted the place to the map's datum; the record itself does
    /// not change. None shows nobody.
    const std::shared_ptr<KTRVALocation>& location() const { return location_; }
    void setLocation(std::shared_ptr<KTRVALocation> location);
    /// Shows the fence; its place is taken as it stands.
    const std::shared_ptr<platform::VAKtrGeoFence>& geoFence() const { return geoFence_; }
    void setGeoFence(std::shared_ptr<platform::VAKtrGeoFence> geoFence);
    /// Puts the pin, with the friend's monogram, and the circle of the accuracy at this place; on a visibility map it
    /// only chooses the region.
    virtual void updateMapWithLocation(const std::shared_ptr<platform::VALocation>& location);
    /// Puts the marker and the circle of the fence's radius in place, and chooses the region.
    virtual void updateFenceMap();
    /// Chooses the region and shows it; waits for nothing, whatever its name says: callers wait. The first region is
    /// there at once, later ones are glided to. Nothing happens while the place is unknown, and on a fence's map.
    virtual void runMapRegionAfterDelay();
    /// The friend in the friend-location app; never none, also with nobody on the map.
    std::optional<platform::Url> urlForTouch() override;
    /// Shows the pin's place in the user's application for maps.
    void openInMaps();

    /// Made at first use, for the friend or else for the fence, and kept whatever is shown later.
    std::shared_ptr<KTRVAMapAnnotation> mapAnnotation();
    void setMapAnnotation(std::shared_ptr<KTRVAMapAnnotation> annotation) { mapAnnotation_ = std::move(annotation); }
    /// The map of the user's own place, without a friend.
    bool isVisibilityMap() const { return isVisibilityMap_; }
    void setIsVisibilityMap(bool isVisibilityMap) { isVisibilityMap_ = isVisibilityMap; }
    /// A region has been shown; later ones are animated.
    bool isRegionSetOnMap() const { return isRegionSetOnMap_; }
    void setIsRegionSetOnMap(bool isSet) { isRegionSetOnMap_ = isSet; }
    /// Where the user is. Held weakly.
    std::shared_ptr<CurrentLocationDelegate> currentLocationDelegate() const { return currentLocationDelegate_.lock(); }
    void setCurrentLocationDelegate(std::weak_ptr<CurrentLocationDelegate> delegate) {
        currentLocationDelegate_ = std::move(delegate);
    }
    /// Degrees of latitude and longitude: the most that a region with the user in it spans, and the least that another
    /// one does.
    double zoomLevel() const { return zoomLevel_; }
    void setZoomLevel(double zoomLevel) { zoomLevel_ = zoomLevel; }
    const std::shared_ptr<platform::PlatformMapView>& mapView() const { return mapView_; }
    void setMapView(std::shared_ptr<platform::PlatformMapView> mapView) { mapView_ = std::move(mapView); }
    const std::shared_ptr<platform::LocationShifter>& locationShifter() const { return locationShifter_; }
    void setLocationShifter(std::shared_ptr<platform::LocationShifter> shifter) {
        locationShifter_ = std::move(shifter);
    }

    platform::AccessibilityRole accessibilityRole() const override { return platform::AccessibilityRole::Link; }
    /// What the map shows, in words.
    std::string accessibilityText() const override;

  private:
    void setupMap();
    void setupConstraints(const platform::Size& size);
    void updatePin(const std::shared_ptr<platform::VALocation>& location);
    void updateCircle(const std::optional<double>& accuracy);
    platform::MapRegion friendRegion();

    bool isVisibilityMap_ = false;
    bool isRegionSetOnMap_ = false;
    std::weak_ptr<CurrentLocationDelegate> currentLocationDelegate_;
    std::shared_ptr<KTRVALocation> location_;
    std::shared_ptr<platform::VAKtrGeoFence> geoFence_;
    double zoomLevel_ = 0.0;
    std::shared_ptr<platform::PlatformMapView> mapView_;
    std::shared_ptr<KTRVAMapAnnotation> mapAnnotation_;
    std::shared_ptr<platform::LocationShifter> locationShifter_;
    /// Counts what the shifter was asked: only the answer to the latest question counts.
    unsigned shifts_ = 0;
    platform::NotificationCenter::Token currentLocationUpdated_;
};

}  // namespace ktr
