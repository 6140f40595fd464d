#pragma once

#include <memory>

#include "host/Host.h"
#include "host/scenario/Scenario.h"

namespace ktr::bench {

/// The whole program without a window, for the scenario of `file`, with no turn yet; none, with a line on the standard
/// error, when there cannot be one.
std::unique_ptr<host::Host> hostFor(const char* file, const host::Scenario& scenario, host::Host::Time time);

/// The `main` of a bench of one scenario: the arguments, the application, then `run` with the file's name.
int runScenario(int argc, char** argv, int (*run)(const char* file));

}  // namespace ktr::bench
