#include "linux/maps/TileCache.h"

#include <utility>

namespace ktr::linux_ {

namespace {

/// What an entry takes itself; bytes.
constexpr std::size_t kEntryBytes = 200;

}  // namespace

std::optional<std::shared_ptr<const tiles::MapTile>> TileCache::find(const tiles::TileKey& key) {
    const auto found = byKey_.find(key);
    if (found == byKey_.end()) {
        return std::nullopt;
    }
    entries_.splice(entries_.begin(), entries_, found->second);
    return found->second->tile;
}

void TileCache::put(const tiles::TileKey& key, std::shared_ptr<const tiles::MapTile> tile) {
    if (const auto known = byKey_.find(key); known != byKey_.end()) {
        bytes_ -= known->second->bytes;
        entries_.erase(known->second);
        byKey_.erase(known);
    }
    const std::size_t size = kEntryBytes + (tile ? tile->bytes() : 0);
    entries_.push_front({key, std::move(tile), size});
    byKey_[key] = entries_.begin();
    bytes_ += size;
    while (bytes_ > mostBytes_ && !entries_.empty()) {
        bytes_ -= entries_.back().bytes;
        byKey_.erase(entries_.back().key);
        entries_.pop_back();
    }
}

void TileCache::clear() {
    entries_.clear();
    byKey_.clear();
    bytes_ = 0;
}

}  // namespace ktr::linux_
