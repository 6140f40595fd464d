#pragma once

#include <string>
#include <variant>
#include <vector>

#include "linux/positions/ScenarioLocationManager.h"

namespace ktr::linux_ {

/// Reads a walk from a file: a GPX track (GPX 1.0 and 1.1, https://www.topografix.com/gpx.asp) or the "positions" of a
/// scenario. Any thread; it reads the disk.
class TrackReader {
  public:
    struct Error {
        std::string text;  ///< one line that names the file and the place in it
    };

    /// GPX when the text begins with "<", else a scenario.
    static std::variant<std::vector<TimedPosition>, Error> readFile(const std::string& file);
    /// The points of all tracks, segments and routes, else the waypoints. The first is known from the start on, the
    /// others as much later as their times say; without usable times, ten seconds after each other. An "hdop" of 1
    /// counts as five metres; without one the accuracy is ten metres. Positions carry no timestamps: they are new when
    /// they are reached.
    static std::variant<std::vector<TimedPosition>, Error> readGpx(const std::string& text, const std::string& file);
    static std::variant<std::vector<TimedPosition>, Error> readScenario(const std::string& text,
                                                                        const std::string& file);
};

}  // namespace ktr::linux_
