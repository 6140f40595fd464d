#pragma once

#include <string>

#include "host/ExitCode.h"

namespace ktr::host {

/// Why something was not done: one line for the user, and what the program's exit status says of it.
struct Failure {
    ExitCode code = ExitCode::Failure;
    std::string line;
};

}  // namespace ktr::host
