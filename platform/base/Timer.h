#pragma once

#include <functional>

#include "platform/base/Api.h"
#include "platform/base/Object.h"

namespace ktr::platform {

/// A timer of the main loop. Dropping the last reference does not stop it; `invalidate` does. Main thread.
class KTR_API Timer : public Object {
  public:
    /// Stops the timer for good. Calling it again does nothing.
    virtual void invalidate() = 0;
    /// False once invalidated, and once a one-shot timer has fired.
    virtual bool isValid() const = 0;
    /// Seconds.
    virtual double interval() const = 0;
};

}  // namespace ktr::platform
