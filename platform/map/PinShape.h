#pragma once

#include "platform/base/Geometry.h"
#include "platform/ui/Path.h"

namespace ktr::platform {

class Canvas;

/// The outline of a pin whose tip stands at 0, 0: a circle of radius `radius` whose lower end runs into the tip.
/// Points.
struct KTR_API PinShape {
    double radius = 0.0;
    /// From the circle's lower end down to the tip.
    double tip = 0.0;
    /// Where the circle is left, degrees to either side of straight down.
    double departure = 25.0;

    Path outline() const;
    Point centre() const { return {0.0, -radius - tip}; }
    /// Room for the outline, its edge and the shadow, around the tip.
    Rect extent() const;
    /// The soft ellipse under the tip.
    static void drawShadow(Canvas& canvas);
};

}  // namespace ktr::platform
