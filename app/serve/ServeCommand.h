#pragma once

#include "app/ExitCode.h"
#include "app/serve/ServeOptions.h"

namespace ktr::app {

/// `ktr serve`: starts the development service, says so on the standard output and serves until SIGINT, SIGTERM or,
/// when asked for, the end of the standard input. Main thread, before any other thread exists.
class ServeCommand {
  public:
    static ExitCode run(const ServeOptions& options);
};

}  // namespace ktr::app
