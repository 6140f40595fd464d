#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <variant>
#include <vector>

#include "tiles/TilesetFacts.h"

namespace ktr::linux_ {

/// What is in a file with a map. A value; any thread.
struct MapFile {
    bool hasStreets = false;  ///< vector tiles, drawn in ktr's own style; else pictures
    int coarsest = 0;         ///< levels
    int finest = 0;
    std::string attribution;
    /// South-west and north-east, degrees; none where the file does not say what it covers.
    struct Corners {
        double south = 0.0, west = 0.0, north = 0.0, east = 0.0;
    };
    std::optional<Corners> corners;
    /// The largest towns in it, at most three; of the world that is built in, in its language.
    std::vector<std::string> towns;

    /// Opens the file and reads a tile of it; a line that says what is wrong where that cannot be done. `world`: the
    /// file of the built-in world. Waits for the disk.
    static std::variant<MapFile, std::string> read(const std::string& path, const std::filesystem::path& world,
                                                   const std::string& language);
    /// The same as a line: "streets of Brinmouth, levels 8 to 14, 50.19 to 50.23 north, …".
    std::string description() const;
};

}  // namespace ktr::linux_
