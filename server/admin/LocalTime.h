#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace ktr::server {

/// When a grant ends, in the words of a command line: "midnight", "18:30" (the next one in this machine's zone), or an
/// ISO time. Seconds since 1970; none for anything else and for what is over.
std::optional<std::int64_t> endingOf(const std::string& words, std::int64_t now);

}  // namespace ktr::server
