#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace ktr::documents {

/// A text from outside, fit for one line of a message: in quotes, control characters escaped, malformed UTF-8 replaced,
/// shortened to about `longest` bytes.
std::string inQuotes(std::string_view text, std::size_t longest = 60);

}  // namespace ktr::documents
