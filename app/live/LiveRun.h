#pragma once

#include <memory>
#include <vector>

#include "app/ExitCode.h"
#include "app/live/LiveConversation.h"

namespace ktr::app {

/// Lets a live conversation happen without a window: in real time, with what goes on told on the standard error. Main
/// thread, with Qt's event loop.
class LiveRun {
  public:
    LiveRun(Host& host, const Options& options) : host_(host), options_(options) {}
    /// Asks, answers, and goes on for as long as the options say, counted from the first answer. Ok, or a failure when
    /// a question or a scenario found no answer at all.
    ExitCode run(std::vector<Scenario> scenarios);

  private:
    Host& host_;
    const Options& options_;
};

}  // namespace ktr::app
