#pragma once

#include <string>
#include <variant>
#include <vector>

#include "app/Options.h"
#include "host/ExitCode.h"

namespace ktr::app {

/// Reads the command line. Any thread.
class CommandLine {
  public:
    /// What ends the program at once: help and version on the standard output, or a line about a wrong use on the
    /// standard error.
    struct Ending {
        host::ExitCode code = host::ExitCode::Ok;
        std::string text;
    };

    /// The arguments without the program's name.
    static std::variant<Options, Ending> parse(std::vector<std::string> arguments);
};

}  // namespace ktr::app
