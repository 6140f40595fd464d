#pragma once

#include "host/ExitCode.h"

namespace ktr::app {

/// The whole program: reads the command line, runs the command, prints what went wrong. Main thread, once.
host::ExitCode runProgram(int argc, char** argv);

}  // namespace ktr::app
