#pragma once

#include "platform/base/Api.h"

namespace ktr::platform {

/// What this device's management says about friend locations. Main thread; answers from memory.
class KTR_API FriendLocationRestrictions {
  public:
    virtual ~FriendLocationRestrictions();
    /// Whether the friend-location app is restricted.
    virtual bool isFriendLocationRestricted() const = 0;
    /// Whether friend locations may be used at all.
    virtual bool isFriendLocationAllowed() const = 0;
};

}  // namespace ktr::platform
