#pragma once

#include <compare>

namespace ktr::tiles {

/// One tile of the square that Web Mercator makes of the world: level `z` has 2^z columns from the west (x) and rows
/// from the north (y).
struct TileKey {
    int z = 0;
    int x = 0;
    int y = 0;
    auto operator<=>(const TileKey&) const = default;  // NOLINT(modernize-use-nullptr): it has none

    /// The tile of a coarser level that this one is a part of; itself at its own level. `level` is 0 to z.
    TileKey parent(int level) const { return {level, x >> (z - level), y >> (z - level)}; }
};

}  // namespace ktr::tiles
