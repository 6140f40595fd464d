#pragma once

#include <filesystem>

#include "app/KeepingOptions.h"
#include "host/ExitCode.h"

namespace ktr::app {

/// `ktr config`: tells and changes single settings. It reads and writes the disk.
class ConfigCommand {
  public:
    static host::ExitCode run(const ConfigOptions& options, const std::filesystem::path& file);
};

}  // namespace ktr::app
