#pragma once

#include <cstddef>
#include <list>
#include <memory>

#include <QImage>
#include <QRectF>

#include "linux/maps/MapGround.h"
#include "linux/maps/MapTiles.h"
#include "linux/maps/TilePictures.h"

namespace ktr::linux_ {

/// Draws a map from tiles that are pictures. In the dark they are turned dark. A tile that is missing, or no picture,
/// is filled in from a coarser level; where there is none either, the next ground draws.
class PictureGround final : public MapGround {
  public:
    /// Decoded pictures kept; bytes.
    static constexpr std::size_t kMostBytes = std::size_t{24} << 20;
    /// Pixels a side: a larger picture is scaled down while it is read.
    static constexpr int kLargestSide = 1024;

    explicit PictureGround(std::unique_ptr<TilePictures> pictures) : pictures_(std::move(pictures)) {}

    MapDrawn draw(const MapDrawing& drawing) override;
    void setChangeHandler(std::function<void()> changed) override { pictures_->setChangeHandler(std::move(changed)); }

    /// A map made for light, for the dark: its lightness turned over with the hues kept, paler, on the dark map's tone.
    static void darken(QImage& pixels);

  private:
    struct Kept {
        tiles::TileKey key;
        bool isDark = false;
        unsigned version = 0;
        QImage pixels;  ///< null for what is no picture
    };
    /// A picture, and the part of it that a tile shows.
    struct Found {
        QImage pixels;
        QRectF part;
    };

    QImage read(const tiles::TileKey& key, bool isDark, bool isWanted, bool& isComing);
    std::optional<Found> find(const tiles::TileKey& key, bool isDark, bool& isComing);
    QRegion covered(const PlacedTile& placed) const;

    std::unique_ptr<TilePictures> pictures_;
    std::list<Kept> kept_;  ///< latest used first
    std::size_t keptBytes_ = 0;
};

}  // namespace ktr::linux_
