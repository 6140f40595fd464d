#pragma once

#include <map>
#include <memory>
#include <optional>
#include <string>

#include "platform/ui/Image.h"
#include "tiles/TileKey.h"

namespace ktr::tiles {

/// A file of map tiles (MBTiles 1.3, an SQLite database), read only and trusted in nothing: what it defines beyond
/// tables and joins of them is refused, and a question that takes more than a second of computing, ten of waiting, or
/// too much memory is given up: such a file answers none after that. Neither the file nor anything beside it is
/// written. One thread at a time.
class MbtilesFile {
  public:
    /// A stored tile is at most this large; bytes.
    static constexpr std::size_t kLargestTile = std::size_t{4} << 20;

    virtual ~MbtilesFile() = default;

    /// The rows of the table "metadata", by name; the first 256, without values beyond a mebibyte.
    virtual const std::map<std::string, std::string>& metadata() const = 0;
    /// The finest and coarsest levels that have a tile; none when that cannot be told.
    virtual std::optional<int> finestLevel() = 0;
    virtual std::optional<int> coarsestLevel() = 0;
    /// As stored (a vector tile is mostly compressed); none when there is none, or none that can be read. The file's
    /// rows are counted from the south; keys, as everywhere, from the north.
    virtual std::optional<platform::Bytes> tile(const TileKey& key) = 0;
};

}  // namespace ktr::tiles
