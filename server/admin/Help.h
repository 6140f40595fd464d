#pragma once

#include <CLI/CLI.hpp>
#include <optional>

namespace ktr::server {

/// Reads a command line. Under the help of each command stands an example, and what cannot be understood is said in a
/// sentence with the command that was probably meant. With what the program has to end when there is nothing to do.
std::optional<int> parsed(CLI::App& program, int count, const char* const* words);

}  // namespace ktr::server
