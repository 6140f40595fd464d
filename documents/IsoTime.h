#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "platform/base/Date.h"

namespace ktr::documents {

/// A moment with the offset in which its clock face was written.
struct IsoTime {
    platform::Date date;
    int offsetSeconds = 0;  ///< east of UTC
    bool operator==(const IsoTime&) const = default;
};

/// Reads an ISO 8601 date and time in its extended form: `2026-05-16T17:42`, seconds and their fraction optional, then
/// `Z`, an offset such as `+02:00`, or nothing, which means UTC. None for anything else, also for a day that does not
/// exist; a leap second is none.
std::optional<IsoTime> parseIsoTime(std::string_view text);

}  // namespace ktr::documents
