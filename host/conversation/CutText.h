#pragma once

#include <cstddef>
#include <string>

namespace ktr::host {

/// The longest beginning of a text (UTF-8) of at most so many bytes that splits no code point.
std::string beginningOf(const std::string& text, std::size_t bytes);

/// The same, with "…" behind it when anything was cut off.
std::string cutText(const std::string& text, std::size_t bytes);

}  // namespace ktr::host
