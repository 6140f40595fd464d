#pragma once

#include <chrono>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "linux/maps/LabelShaper.h"
#include "linux/maps/MapGround.h"
#include "linux/maps/MapTiles.h"
#include "linux/maps/TileCache.h"
#include "linux/maps/TileGeometry.h"
#include "tiles/MbtilesFile.h"
#include "tiles/TilesetFacts.h"

namespace ktr::linux_ {

/// Draws a street map from an MBTiles file of vector tiles. The file is opened by the first drawing, and again when it
/// has changed; a file that cannot be read, or holds pictures instead, draws nothing. A tile that is missing or damaged
/// is filled in from a coarser level; where the file has nothing at all, the next ground draws.
class VectorGround final : public MapGround {
  public:
    /// Decoded tiles kept; bytes.
    static constexpr std::size_t kMostBytes = std::size_t{48} << 20;

    explicit VectorGround(std::string path);

    MapDrawn draw(const MapDrawing& drawing) override;

  private:
    struct Found {
        std::shared_ptr<const tiles::MapTile> tile;
        tiles::TileKey key;  ///< of the tile found: the one asked for, or one of a coarser level
    };

    bool open();
    std::shared_ptr<const tiles::MapTile> read(const tiles::TileKey& key, const std::string& language);
    std::optional<Found> find(const tiles::TileKey& key, const std::string& language);
    std::optional<VisibleTile> place(const PlacedTile& placed, const Found& found, const QRectF& shown) const;
    QRegion covered(const PlacedTile& placed) const;

    std::string path_;
    std::shared_ptr<tiles::MbtilesFile> file_;
    /// When the file was looked at last, and what it was then.
    std::optional<std::chrono::steady_clock::time_point> opened_;
    std::filesystem::file_time_type written_;
    std::string reported_;  ///< the last reason in the log
    tiles::TilesetFacts facts_;
    int coarsest_ = 0;
    int finest_ = 0;
    std::string language_;  ///< of the names in the cache
    TileCache cache_{kMostBytes};
    LabelShaper shaper_;
};

}  // namespace ktr::linux_
