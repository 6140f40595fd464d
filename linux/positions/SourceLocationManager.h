#pragma once

#include <memory>

#include "linux/positions/PositionHub.h"
#include "platform/location/PlatformLocationManager.h"

namespace ktr::linux_ {

/// A location manager on a shared source. After starting, a position that is already known is delivered on a later turn
/// of the main loop, then each new one that the distance filter lets through. Main thread.
class SourceLocationManager : public platform::PlatformLocationManager {
  public:
    explicit SourceLocationManager(std::shared_ptr<PositionHub> hub) : hub_(std::move(hub)) {}
    ~SourceLocationManager() override;

    void setDesiredAccuracy(double metres) override;
    void setDistanceFilter(double metres) override { distanceFilter_ = metres; }
    void startUpdatingLocation() override;
    void stopUpdatingLocation() override;
    std::shared_ptr<platform::PlatformLocation> location() const override { return hub_->newest(); }

    double desiredAccuracy() const { return desiredAccuracy_; }
    /// A new position from the hub.
    void receive(const std::shared_ptr<platform::PlatformLocation>& position);

  private:
    std::shared_ptr<PositionHub> hub_;
    double desiredAccuracy_ = platform::kLocationAccuracyNearestTenMeters;
    double distanceFilter_ = 0.0;
    bool updating_ = false;
    /// Counts the starts: what was posted for an earlier one is void.
    unsigned round_ = 0;
    std::shared_ptr<platform::PlatformLocation> lastDelivered_;
};

}  // namespace ktr::linux_
