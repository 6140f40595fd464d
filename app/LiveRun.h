#pragma once

#include <memory>
#include <vector>

#include "app/Options.h"
#include "host/ExitCode.h"
#include "host/live/LiveConversation.h"

namespace ktr::app {

/// Lets a live conversation happen without a window: in real time, with progress reported on the standard error. Main
/// thread, with Qt's event loop.
class LiveRun {
  public:
    LiveRun(host::Host& host, const Options& options) : host_(host), options_(options) {}
    /// Asks, answers, and goes on for as long as the options say, counted from the first answer. Ok, or a failure when
    /// a question or a scenario found no answer at all.
    host::ExitCode run(std::vector<host::Scenario> scenarios);

  private:
    host::Host& host_;
    const Options& options_;
};

}  // namespace ktr::app
