#pragma once

#include "platform/base/Clock.h"

namespace ktr::linux_ {

/// The system's clock. Any thread.
class SystemClock : public platform::Clock {
  public:
    platform::Date now() const override;
};

}  // namespace ktr::linux_
