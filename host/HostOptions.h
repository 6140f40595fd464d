#pragma once

#include <optional>
#include <string>

#include "documents/IsoTime.h"
#include "platform/ui/Device.h"

namespace ktr::host {

/// What somebody asks of a host. Members that are none leave the decision to the scenario, then to the session.
struct HostOptions {
    double width = 0.0;  ///< points; 0: the idiom's own
    double scale = 1.0;  ///< pixels a point
    std::optional<std::string> language;
    std::optional<platform::ContentSizeCategory> textSize;
    std::optional<platform::UserInterfaceIdiom> idiom;
    /// The moment of the picture: a date and time, or seconds after the scenario's start.
    std::optional<documents::IsoTime> at;
    std::optional<double> atSeconds;
    std::optional<bool> dark;
    bool highContrast = false;
};

}  // namespace ktr::host
