#pragma once

#include <optional>
#include <string>

#include "ask/Language.h"
#include "platform/base/Date.h"

namespace ktr::ask {

/// The moment that words mean ("six", "18:30", "tonight", "two hours"): the next one of that name after `now` by a
/// clock so many seconds from UTC. An hour that two times of day share is the nearer one; "tonight" ends at midnight.
/// None: the words name none. Any thread.
std::optional<platform::Date> momentOf(const std::string& words, const Language& language, platform::Date now,
                                       double secondsFromUtc);

}  // namespace ktr::ask
