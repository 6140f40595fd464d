#pragma once

#include <vector>

#include "platform/base/Geometry.h"

namespace ktr::platform {

/// One finger, pen or button. The location is in the window's coordinates, points.
struct Touch {
    Point location;
};

using Touches = std::vector<Touch>;

/// What came with the touches: seconds since the reference date.
struct TouchEvent {
    double timestamp = 0.0;
};

}  // namespace ktr::platform
