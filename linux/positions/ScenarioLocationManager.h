#pragma once

#include <memory>
#include <optional>
#include <vector>

#include "platform/base/Clock.h"
#include "platform/base/MainLoop.h"
#include "platform/location/Geodesy.h"
#include "platform/location/PlatformLocationManager.h"

namespace ktr::linux_ {

/// A position and when it becomes known: seconds after the scenario's start (0 or less: from the start on).
struct TimedPosition {
    double seconds = 0.0;
    platform::PlatformLocation::Fix fix;
};

/// A walk that is known beforehand, shared by the managers that follow it.
struct Walk {
    std::vector<TimedPosition> positions;  ///< by ascending time
    platform::Date start;
    std::shared_ptr<platform::MainLoop> mainLoop;
    std::shared_ptr<platform::Clock> clock;
    std::shared_ptr<platform::Geodesy> geodesy;
};

/// A location manager that follows a walk. After starting, the newest position known so far is delivered on a later
/// turn of the main loop, and each later one at its time, unless the distance filter holds it back. A desired accuracy
/// changes nothing: the walk is as exact as it was written. Main thread.
class ScenarioLocationManager : public platform::PlatformLocationManager {
  public:
    explicit ScenarioLocationManager(std::shared_ptr<const Walk> walk) : walk_(std::move(walk)) {}
    ~ScenarioLocationManager() override;

    void setDesiredAccuracy(double metres) override;
    void setDistanceFilter(double metres) override { distanceFilter_ = metres; }
    void startUpdatingLocation() override;
    void stopUpdatingLocation() override;
    std::shared_ptr<platform::PlatformLocation> location() const override;

  private:
    double elapsed() const;
    /// How many positions are known now.
    std::size_t known() const;
    std::shared_ptr<platform::PlatformLocation> positionAt(std::size_t index) const;
    void scheduleNext(std::size_t index);
    void reach(std::size_t index);
    void deliver(const std::shared_ptr<platform::PlatformLocation>& position);

    std::shared_ptr<const Walk> walk_;
    double distanceFilter_ = 0.0;
    bool updating_ = false;
    std::shared_ptr<platform::Timer> timer_;
    std::shared_ptr<platform::PlatformLocation> lastDelivered_;
    /// The position handed out last, so that asking again gives the same object.
    mutable std::shared_ptr<platform::PlatformLocation> current_;
    mutable std::size_t currentIndex_ = 0;
};

}  // namespace ktr::linux_
