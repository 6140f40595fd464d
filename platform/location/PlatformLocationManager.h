#pragma once

#include <memory>
#include <vector>

#include "platform/base/Bundle.h"
#include "platform/location/PlatformLocation.h"

namespace ktr::platform {

class PlatformLocationManager;

using PlatformLocations = std::vector<std::shared_ptr<PlatformLocation>>;

class KTR_API PlatformLocationManagerDelegate {
  public:
    virtual ~PlatformLocationManagerDelegate();
    /// New positions, the newest last; never an empty list from a manager. Main thread.
    virtual void didUpdateLocations(PlatformLocationManager& manager, const PlatformLocations& locations) = 0;
};

/// Metres; the platform's level for "nearest ten metres".
inline constexpr double kLocationAccuracyNearestTenMeters = 10.0;

/// Where the user is. Without authorisation, hardware or a fix it simply delivers nothing. Main thread.
class KTR_API PlatformLocationManager : public Object {
  public:
    void setDelegate(std::weak_ptr<PlatformLocationManagerDelegate> delegate) { delegate_ = std::move(delegate); }
    std::shared_ptr<PlatformLocationManagerDelegate> delegate() const { return delegate_.lock(); }

    /// Metres.
    virtual void setDesiredAccuracy(double metres) = 0;
    /// Positions nearer than this to the last one delivered are not delivered; metres.
    virtual void setDistanceFilter(double metres) = 0;
    virtual void startUpdatingLocation() = 0;
    virtual void stopUpdatingLocation() = 0;
    /// The newest position known, also without updates running; may be none.
    virtual std::shared_ptr<PlatformLocation> location() const = 0;

  private:
    std::weak_ptr<PlatformLocationManagerDelegate> delegate_;
};

class KTR_API LocationManagerFactory {
  public:
    virtual ~LocationManagerFactory();
    /// A manager that asks for the user's position in the name of this bundle (may be none). Never none.
    virtual std::shared_ptr<PlatformLocationManager> makeManager(const std::shared_ptr<Bundle>& effectiveBundle) = 0;
};

}  // namespace ktr::platform
