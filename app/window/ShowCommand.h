#pragma once

#include "app/Options.h"
#include "host/ExitCode.h"
#include "host/Host.h"

namespace ktr::app {

/// Opens a window on a host's conversation, until it is closed. Main thread.
class ShowCommand {
  public:
    ShowCommand(host::Host& host, const Options& options) : host_(host), options_(options) {}
    /// The scenarios are those that come once the account is read, where the window is live.
    host::ExitCode run(const std::vector<host::Scenario>& scenarios);

  private:
    host::Host& host_;
    const Options& options_;
};

}  // namespace ktr::app
