#pragma once

#include <string_view>

#include "documents/DocumentError.h"

namespace ktr::app {

/// One line for the user on the standard error: `ktr: ` and the text, in which nothing steers the terminal.
void tell(std::string_view line);
/// A line a warning.
void tell(const documents::DocumentWarnings& warnings);

}  // namespace ktr::app
