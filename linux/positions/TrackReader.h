#pragma once

#include <string>
#include <variant>
#include <vector>

#include "documents/DocumentError.h"
#include "linux/positions/ScenarioLocationManager.h"

namespace ktr::linux_ {

/// Reads a walk from a file: a GPX track (GPX 1.0 and 1.1, https://www.topografix.com/gpx.asp) or the "positions" of a
/// scenario. Any thread; it reads the disk.
class TrackReader {
  public:
    using Track = std::vector<TimedPosition>;

    /// GPX when the text begins with "<", else a scenario. Unknown members of positions go to `warnings`, if there are
    /// any to go to.
    static std::variant<Track, documents::DocumentError> readFile(const std::string& file,
                                                                  documents::DocumentWarnings* warnings = nullptr);
    /// The points of all tracks, segments and routes, else the waypoints. The first is known from the start on, the
    /// others as much later as their times say; without usable times, ten seconds after each other. An "hdop" of 1
    /// counts as five metres; without one the accuracy is ten metres. Positions carry no timestamps: they are new when
    /// they are reached. A document type is an error: GPX has none, and entities could make it grow without end.
    static std::variant<Track, documents::DocumentError> readGpx(const std::string& text, const std::string& file);
    static std::variant<Track, documents::DocumentError> readScenario(const std::string& text, const std::string& file,
                                                                      documents::DocumentWarnings* warnings = nullptr);
};

}  // namespace ktr::linux_
