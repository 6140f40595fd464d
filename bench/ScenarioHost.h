#pragma once

#include <memory>

#include "app/Host.h"
#include "app/Scenario.h"

namespace ktr::bench {

/// The whole program without a window, for the scenario of `file`, with no turn yet; none, with a line on the standard
/// error, when there cannot be one.
std::unique_ptr<app::Host> hostFor(const char* file, const app::Scenario& scenario, app::Host::Time time);

/// The `main` of a bench of one scenario: the arguments, the application, then `run` with the file's name.
int runScenario(int argc, char** argv, int (*run)(const char* file));

}  // namespace ktr::bench
