#include "server/names/TileNames.h"

#include <iterator>
#include <utility>

namespace ktr::server {

namespace {

/// What an entry takes beside its names: two nodes and a key.
constexpr std::size_t kEntryBytes = 256;

}  // namespace

std::size_t TileNames::bytes() const {
    std::size_t total = sizeof *this + streets.bytes() + towns.capacity() * sizeof(TileTown);
    for (const TileTown& town : towns) {
        total += town.name.capacity();
    }
    return total;
}

std::optional<std::shared_ptr<const TileNames>> TileNameCache::find(const Key& key) {
    const auto found = byKey_.find(key);
    if (found == byKey_.end()) {
        return std::nullopt;
    }
    entries_.splice(entries_.begin(), entries_, found->second);
    return found->second->names;
}

void TileNameCache::put(const Key& key, std::shared_ptr<const TileNames> names) {
    if (const auto found = byKey_.find(key); found != byKey_.end()) {
        drop(found->second);
    }
    const std::size_t bytes = kEntryBytes + (names ? names->bytes() : 0);
    entries_.push_front({key, std::move(names), bytes});
    byKey_.emplace(key, entries_.begin());
    bytes_ += bytes;
    while (bytes_ > mostBytes_) {
        drop(std::prev(entries_.end()));
    }
}

void TileNameCache::forget(int file) {
    for (auto entry = entries_.begin(); entry != entries_.end();) {
        const auto next = std::next(entry);
        if (entry->key.file == file) {
            drop(entry);
        }
        entry = next;
    }
}

void TileNameCache::drop(std::list<Entry>::iterator entry) {
    bytes_ -= entry->bytes;
    byKey_.erase(entry->key);
    entries_.erase(entry);
}

}  // namespace ktr::server
