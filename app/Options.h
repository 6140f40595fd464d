#pragma once

#include <optional>
#include <string>
#include <vector>

#include "app/IsoTime.h"
#include "app/serve/ServeOptions.h"
#include "platform/ui/Device.h"

namespace ktr::app {

/// What the command line asks for. Members that are none leave the decision to the scenario, then to the session.
struct Options {
    enum class Command { Show, Render, Describe, Serve };

    Command command = Command::Show;
    std::vector<std::string> scenarios;  ///< never empty where nothing is live, but for serve
    /// With the account, the service and the present moment: a window without scenarios, and what --live asks for.
    bool live = false;
    double liveSeconds = 0.0;            ///< of a live render and describe: how long it goes on
    std::vector<std::string> questions;  ///< of what is live: asked at the start, in this order
    std::string output;                  ///< of render: a file ending in .png, .svg or .pdf
    double width = 0.0;                  ///< points; 0: the idiom's own
    double scale = 1.0;                  ///< pixels a point
    std::optional<std::string> language;
    std::optional<platform::ContentSizeCategory> textSize;
    std::optional<platform::UserInterfaceIdiom> idiom;
    /// The moment of the picture: a date and time, or seconds after the scenario's start.
    std::optional<IsoTime> at;
    std::optional<double> atSeconds;
    std::optional<bool> dark;
    bool highContrast = false;
    std::string plugin;          ///< empty: looked for
    ServeOptions serve;          ///< of serve
    bool reducedMotion = false;  ///< of show
    bool printUrls = false;      ///< of show: URLs go to the standard output instead of the desktop
};

}  // namespace ktr::app
