#pragma once

#include "host/ExitCode.h"
#include "serve/ServeOptions.h"

namespace ktr::app {

/// `ktr serve`: starts the development service, says so on the standard output and serves until SIGINT, SIGTERM or,
/// when asked for, the end of the standard input. Main thread, before any other thread exists.
class ServeCommand {
  public:
    static host::ExitCode run(const serve::ServeOptions& options);
};

}  // namespace ktr::app
