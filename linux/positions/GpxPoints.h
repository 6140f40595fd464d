#pragma once

#include <optional>
#include <string>
#include <variant>
#include <vector>

#include "documents/DocumentError.h"
#include "platform/location/PlatformLocation.h"

namespace ktr::linux_ {

/// The points of a GPX document, in its order. Any thread.
struct GpxPoints {
    struct Point {
        platform::PlatformLocation::Fix fix;
        std::optional<double> time;  ///< seconds since 2001-01-01 UTC
    };
    std::vector<Point> track;      ///< of tracks and routes
    std::vector<Point> waypoints;  ///< standing for themselves

    /// Well-formed XML without a document type, not nested deeper than 64 levels, whose points have their place.
    static std::variant<GpxPoints, documents::DocumentError> read(const std::string& text, const std::string& file);
};

}  // namespace ktr::linux_
