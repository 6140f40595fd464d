#pragma once

#include <cstdint>
#include <filesystem>
#include <mutex>
#include <optional>
#include <string>

#include "platform/ui/Image.h"
#include "tiles/TileKey.h"

namespace ktr::linux_ {

/// Tiles that were fetched, kept on disk between runs: a file each, below a folder that may hold other stores too. What
/// was not used for longest goes when all of them together exceed the cap. A damaged file is no tile. Any thread; it
/// waits for the disk.
class TileStore {
  public:
    struct Entry {
        platform::Bytes data;
        std::int64_t expires = 0;  ///< seconds since 1970
        std::string etag;          ///< as the server sent it; empty for none
        std::string modified;      ///< Last-Modified, as sent
    };
    /// No tile is larger.
    static constexpr std::size_t kLargestTile = std::size_t{1} << 20;

    /// `name` tells stores apart: the address that the tiles come from.
    TileStore(std::filesystem::path root, const std::string& name, std::uint64_t mostBytes);

    std::optional<Entry> load(const tiles::TileKey& key);
    /// Failing to write loses the tile and nothing else.
    void save(const tiles::TileKey& key, const Entry& entry);

  private:
    std::filesystem::path fileOf(const tiles::TileKey& key) const;
    void trim();

    std::filesystem::path root_;
    std::filesystem::path folder_;
    std::uint64_t mostBytes_;
    std::mutex mutex_;
    std::uint64_t written_ = 0;  ///< bytes since the last look at all
    bool isTrimmed_ = false;
};

}  // namespace ktr::linux_
