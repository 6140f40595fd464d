#pragma once

#include "app/KeepingOptions.h"
#include "host/ExitCode.h"

namespace ktr::app {

/// `ktr doctor`: what is fine and what is wrong, with what mends it. Main thread, while a QGuiApplication exists; it
/// waits.
class DoctorCommand {
  public:
    static host::ExitCode run(const DoctorOptions& options);
};

}  // namespace ktr::app
