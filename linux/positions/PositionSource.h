#pragma once

#include <functional>

#include "platform/location/PlatformLocation.h"

namespace ktr::linux_ {

/// Where positions come from. A source that is absent, refuses or dies simply tells nothing, and tries again by itself
/// for as long as it is started. Main thread.
class PositionSource {
  public:
    using Listener = std::function<void(const platform::PlatformLocation::Fix&)>;

    virtual ~PositionSource() = default;
    /// Starts, or goes on with another accuracy; metres. The listener is called on later turns of the main loop.
    virtual void start(double desiredAccuracy) = 0;
    virtual void stop() = 0;
    void setListener(Listener listener) { listener_ = std::move(listener); }

  protected:
    void tell(const platform::PlatformLocation::Fix& fix) const {
        if (listener_) {
            listener_(fix);
        }
    }

  private:
    Listener listener_;
};

}  // namespace ktr::linux_
