#pragma once

#include "app/ExitCode.h"

namespace ktr::app {

/// The whole program: reads the command line, runs the command, prints what went wrong. Main thread, once.
ExitCode runProgram(int argc, char** argv);

}  // namespace ktr::app
