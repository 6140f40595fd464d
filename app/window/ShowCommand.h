#pragma once

#include "app/ExitCode.h"
#include "app/Host.h"
#include "app/Options.h"

namespace ktr::app {

/// Opens a window on a host's conversation, until it is closed. Main thread.
class ShowCommand {
  public:
    ShowCommand(Host& host, const Options& options) : host_(host), options_(options) {}
    /// The scenarios are those that come once the account is read, where the window is live.
    ExitCode run(const std::vector<Scenario>& scenarios);

  private:
    Host& host_;
    const Options& options_;
};

}  // namespace ktr::app
