#pragma once

#include <optional>

#include "platform/location/PlatformLocation.h"

namespace ktr::linux_ {

/// What counts as a position, whichever source it comes from: everything that is handed to a location manager, and so
/// may be sent, has passed here. Any thread.
struct FixPolicy {
    /// Half way round the earth, metres: an error beyond it is no estimate.
    static constexpr double kMostAccuracy = 20'037'508.0;
    /// Beyond any aircraft, metres up or down; and faster than any, metres a second.
    static constexpr double kMostAltitude = 100'000.0;
    static constexpr double kMostSpeed = 10'000.0;

    /// None for a place that is on no earth, and for an accuracy that is negative, no number, or beyond kMostAccuracy.
    /// An altitude, a course, a speed or a time that cannot be is taken as unknown; the position then stays.
    static std::optional<platform::PlatformLocation::Fix> checked(platform::PlatformLocation::Fix fix);
};

}  // namespace ktr::linux_
