#pragma once

#include <functional>
#include <memory>

#include "platform/location/PlatformLocationManager.h"

namespace ktr::platform {

/// Hears of the user's position for a map, from `start` until it goes. Main thread.
class MapUserTracker : public PlatformLocationManagerDelegate, public std::enable_shared_from_this<MapUserTracker> {
  public:
    using Moved = std::function<void(const std::shared_ptr<PlatformLocation>& location)>;

    /// `moved` hears of positions that are some, each once.
    explicit MapUserTracker(Moved moved);
    ~MapUserTracker() override;

    void start(const std::shared_ptr<PlatformLocationManager>& manager);
    /// Tells the newest position that is known now.
    void catchUp();
    void didUpdateLocations(PlatformLocationManager& manager, const PlatformLocations& locations) override;

  private:
    void tell(const std::shared_ptr<PlatformLocation>& location);

    const Moved moved_;
    std::shared_ptr<PlatformLocationManager> manager_;
    std::shared_ptr<PlatformLocation> told_;
};

}  // namespace ktr::platform
