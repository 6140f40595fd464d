#pragma once

#include <string>

#include "platform/ui/Font.h"

namespace ktr {

/// Shortens a copy of the text, four characters less and "..." more each time, until it is no wider than `width` points
/// in this font, and returns the text itself, unchanged. That nothing is ever shortened is intended. Main thread.
std::string stringConstrainedToWidth(const std::string& text, double width, const platform::Font& font);

}  // namespace ktr
