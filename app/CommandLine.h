#pragma once

#include <string>
#include <variant>
#include <vector>

#include "app/ExitCode.h"
#include "app/Options.h"

namespace ktr::app {

/// Reads the command line. Any thread.
class CommandLine {
  public:
    /// What ends the program at once: help and version on the standard output, or a line about a wrong use on the
    /// standard error.
    struct Ending {
        ExitCode code = ExitCode::Ok;
        std::string text;
    };

    /// The arguments without the program's name.
    static std::variant<Options, Ending> parse(std::vector<std::string> arguments);
};

}  // namespace ktr::app
