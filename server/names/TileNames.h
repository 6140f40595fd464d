#pragma once

#include <cstddef>
#include <list>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <tuple>
#include <vector>

#include "server/names/StreetGrid.h"
#include "tiles/TileKey.h"

namespace ktr::server {

/// A town as a tile has it.
struct TileTown {
    float x = 0.0F;  ///< tile units
    float y = 0.0F;
    double reach = 0.0;  ///< how far from there one is still in it, metres
    std::string name;
};

/// What is called something in one tile: its streets, or its towns. A value; once made it is not changed.
struct TileNames {
    StreetGrid streets;
    std::vector<TileTown> towns;

    std::size_t bytes() const;
};

/// The names of tiles, those used latest, up to a number of bytes. One thread at a time.
class TileNameCache {
  public:
    explicit TileNameCache(std::size_t mostBytes) : mostBytes_(mostBytes) {}

    struct Key {
        int file = 0;
        std::string language;
        tiles::TileKey tile;

        bool operator<(const Key& other) const {
            return std::tie(file, tile, language) < std::tie(other.file, other.tile, other.language);
        }
    };

    /// None when it is not known; null when it is known that there is no such tile.
    std::optional<std::shared_ptr<const TileNames>> find(const Key& key);
    void put(const Key& key, std::shared_ptr<const TileNames> names);
    /// Forgets all of a file.
    void forget(int file);
    std::size_t bytes() const { return bytes_; }

  private:
    struct Entry {
        Key key;
        std::shared_ptr<const TileNames> names;
        std::size_t bytes = 0;
    };
    void drop(std::list<Entry>::iterator entry);

    const std::size_t mostBytes_;
    std::size_t bytes_ = 0;
    std::list<Entry> entries_;  ///< latest used first
    std::map<Key, std::list<Entry>::iterator> byKey_;
};

}  // namespace ktr::server
