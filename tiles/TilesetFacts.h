#pragma once

#include <map>
#include <optional>
#include <string>
#include <string_view>

namespace ktr::tiles {

/// What a tile set says about itself, in the members of MBTiles' metadata, with what makes no sense left out. A value;
/// any thread.
struct TilesetFacts {
    /// The part of the world that it covers, in shares of Web Mercator's square from the north-west: 0 to 1.
    struct Bounds {
        double left = 0.0, top = 0.0, right = 1.0, bottom = 1.0;
    };

    std::string format;           ///< lower case: "pbf", "png", "jpg", "webp"; empty when it does not say
    std::optional<int> coarsest;  ///< levels, 0 to 30
    std::optional<int> finest;
    std::optional<Bounds> bounds;  ///< none for one that says nothing, or nonsense
    std::string name;              ///< plain text; empty when it has none
    std::string attribution;       ///< plain text; without one the set's name, or "Offline map"

    static TilesetFacts of(const std::map<std::string, std::string>& metadata);
    /// Text without markup: tags taken out, the common entities read, blanks made single, at most 120 characters.
    static std::string plainText(std::string_view markup);
};

}  // namespace ktr::tiles
