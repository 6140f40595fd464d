#pragma once

#include <vector>

#include "documents/FieldReader.h"
#include "platform/location/PlatformLocation.h"

namespace ktr::linux_ {

/// Where the user is from a moment on.
struct ScenarioPosition {
    double at = 0.0;  ///< seconds after the scenario's start
    platform::Coordinate coordinate;
    double accuracy = 10.0;  ///< metres
};

/// The "positions" of a scenario, in the order of their time; a complaint for what is none. Any thread.
std::vector<ScenarioPosition> readScenarioPositions(documents::FieldReader& scenario);

}  // namespace ktr::linux_
