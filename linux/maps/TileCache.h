#pragma once

#include <cstddef>
#include <list>
#include <map>
#include <memory>
#include <optional>

#include "tiles/MapTile.h"
#include "tiles/TileKey.h"

namespace ktr::linux_ {

/// Decoded tiles, the latest used ones up to a number of bytes. One thread at a time.
class TileCache {
  public:
    explicit TileCache(std::size_t mostBytes) : mostBytes_(mostBytes) {}

    /// None when it is not known; null when it is known that there is none.
    std::optional<std::shared_ptr<const tiles::MapTile>> find(const tiles::TileKey& key);
    void put(const tiles::TileKey& key, std::shared_ptr<const tiles::MapTile> tile);
    void clear();
    std::size_t bytes() const { return bytes_; }

  private:
    struct Entry {
        tiles::TileKey key;
        std::shared_ptr<const tiles::MapTile> tile;
        std::size_t bytes = 0;
    };

    std::size_t mostBytes_;
    std::size_t bytes_ = 0;
    std::list<Entry> entries_;  ///< latest used first
    std::map<tiles::TileKey, std::list<Entry>::iterator> byKey_;
};

}  // namespace ktr::linux_
