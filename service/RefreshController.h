#pragma once

#include <memory>

#include "platform/base/Bundle.h"
#include "platform/base/Object.h"
#include "platform/location/PlatformLocationManager.h"
#include "views/CurrentLocationDelegate.h"

namespace ktr {

/// Tracks the user's own position while a snippet is on screen, and posts kCurrentLocationUpdatedNotification, itself
/// the sender, when the user has moved more than 10 metres since the last position. Main thread.
class RefreshController : public platform::Object,
                          public CurrentLocationDelegate,
                          public platform::PlatformLocationManagerDelegate {
  public:
    /// Stops position updates.
    ~RefreshController() override;

    /// Starts position updates in the name of this bundle (may be none), and takes over the position that is already
    /// known.
    virtual bool initWithBundle(const std::shared_ptr<platform::Bundle>& bundle);

    std::shared_ptr<platform::PlatformLocation> currentLocation() const override { return currentLocation_; }
    void setCurrentLocation(std::shared_ptr<platform::PlatformLocation> location) {
        currentLocation_ = std::move(location);
    }
    const std::shared_ptr<platform::PlatformLocationManager>& locationManager() const { return locationManager_; }
    void setLocationManager(std::shared_ptr<platform::PlatformLocationManager> manager) {
        locationManager_ = std::move(manager);
    }

    /// Takes over the newest, the last of the list. The first position after none posts nothing.
    void didUpdateLocations(platform::PlatformLocationManager& manager,
                            const platform::PlatformLocations& locations) override;

  private:
    std::shared_ptr<platform::PlatformLocationManager> locationManager_;
    std::shared_ptr<platform::PlatformLocation> currentLocation_;
};

}  // namespace ktr
