#pragma once

#include <string>

#include "app/ExitCode.h"

namespace ktr::app {

/// Why something was not done: one line for the user, and what the program's exit status says of it.
struct Failure {
    ExitCode code = ExitCode::Failure;
    std::string line;
};

}  // namespace ktr::app
