#pragma once

#include <functional>
#include <memory>

#include "platform/base/Api.h"
#include "platform/base/Timer.h"

namespace ktr::platform {

/// The host's main loop and its background workers.
class KTR_API MainLoop {
  public:
    using Work = std::function<void()>;

    virtual ~MainLoop();

    /// Runs the work on a later turn of the main loop, in the order of posting. Any thread.
    virtual void post(Work work) = 0;
    /// Fires on the main thread after `seconds` (0 or less: on the next turn, never inside the call), and then every
    /// `seconds` again if it repeats. A repeating timer's interval is at least a millisecond. Main thread.
    virtual std::shared_ptr<Timer> schedule(double seconds, bool repeats, Work work) = 0;
    /// Runs the work on a background worker (user-initiated priority). The work takes its inputs as values and posts
    /// its result back. Any thread.
    virtual void runInBackground(Work work) = 0;
    virtual bool isMainThread() const = 0;
};

}  // namespace ktr::platform
