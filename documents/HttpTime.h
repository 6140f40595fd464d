#pragma once

#include <chrono>
#include <optional>
#include <string_view>

#include "platform/base/Date.h"

namespace ktr::documents {

/// Reads a moment of an HTTP field in the one form that may be sent (RFC 9110, section 5.6.7):
/// `Sun, 06 Nov 1994 08:49:37 GMT`, with blanks around it or without. None for anything else, also for a day that does
/// not exist or has another name.
std::optional<platform::Date> parseHttpTime(std::string_view text);

/// How long a server wants to be left alone from `now` on: the field Retry-After (RFC 9110, section 10.2.3), a count of
/// seconds or a moment as above; not below 0 and at most a year. None for anything else.
std::optional<std::chrono::seconds> parseRetryAfter(std::string_view text, platform::Date now);

}  // namespace ktr::documents
