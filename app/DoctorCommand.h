#pragma once

#include "app/KeepingOptions.h"
#include "host/ExitCode.h"
#include "linux/doctor/CheckUp.h"

namespace ktr::app {

/// `ktr doctor`: what is fine and what is wrong, with what mends it. Main thread, while a QGuiApplication exists; it
/// waits.
class DoctorCommand {
  public:
    static host::ExitCode run(const DoctorOptions& options);
    /// Where a check-up of this session looks.
    static linux_::CheckUp::Places places();
};

}  // namespace ktr::app
