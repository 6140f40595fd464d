#pragma once

#include <string>

#include "host/ExitCode.h"

namespace ktr::app {

/// `ktr maps`: maps of one's own. Any thread; it waits for the disk.
class MapsCommand {
  public:
    /// Checks a file with a map, and has it drawn from then on, by windows that are open too: a link to it stands in
    /// the folder of maps, or a copy where it has no index. Prints what it covers.
    static host::ExitCode add(const std::string& file);
};

}  // namespace ktr::app
