#pragma once

#include <memory>

#include "platform/location/PlatformLocation.h"

namespace ktr {

/// The name of the notification that the user has moved: distances to the user have changed.
inline constexpr const char* kCurrentLocationUpdatedNotification = "ktrCurrentLocationUpdated";

/// Knows where the user is. Main thread.
class CurrentLocationDelegate {
  public:
    virtual ~CurrentLocationDelegate() = default;
    /// The user's newest position, or none.
    virtual std::shared_ptr<platform::PlatformLocation> currentLocation() const = 0;
};

}  // namespace ktr
