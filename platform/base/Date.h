#pragma once

namespace ktr::platform {

/// A moment: seconds since the reference date, 2001-01-01 00:00:00 UTC. Fractions are kept.
struct Date {
    double secondsSinceReferenceDate = 0.0;

    bool operator==(const Date&) const = default;
};

/// Seconds from the Unix epoch (1970-01-01 UTC) to the reference date.
inline constexpr double kSecondsFrom1970ToReferenceDate = 978307200.0;

}  // namespace ktr::platform
