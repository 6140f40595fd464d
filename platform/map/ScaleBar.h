#pragma once

#include "platform/base/Api.h"
#include "platform/base/LengthFormatter.h"

namespace ktr::platform {

/// A length that says how large a map is drawn. A value; any thread.
struct KTR_API ScaleBar {
    double amount = 0.0;
    LengthUnit unit = LengthUnit::Meter;
    double points = 0.0;
    bool operator==(const ScaleBar&) const = default;

    /// The roundest length that is between 40 and 100 points long at this scale: a one with noughts if there is one,
    /// else a five, else a two. Nothing (0 points) for a scale that is not greater than 0.
    static ScaleBar at(double metresPerPoint, LengthSystem system);
};

}  // namespace ktr::platform
