#pragma once

#include <string>

#include "host/ExitCode.h"

namespace ktr::app {

/// `ktr watch`: listens to who came and went, and shows a notification of each, until SIGINT or SIGTERM. Main thread.
class WatchCommand {
  public:
    struct Options {
        bool prints = false;   ///< lines on the standard output instead of notifications
        std::string hook;      ///< an address of the user's own that is told as well; empty: none
        std::string hookKey;   ///< the file of the key that signs what it is told
        std::string language;  ///< BCP 47; empty: the configuration's, else the session's
    };

    static host::ExitCode run(const Options& options, int argc, char** argv);
};

}  // namespace ktr::app
