#pragma once

#include <chrono>
#include <filesystem>
#include <memory>

#include "linux/maps/TilePictures.h"
#include "tiles/MbtilesFile.h"

namespace ktr::linux_ {

/// Pictures from an MBTiles file. It is opened by the first drawing, and again when it has changed; one that cannot be
/// read, or holds vector tiles, has nothing.
class MbtilesPictures final : public TilePictures {
  public:
    explicit MbtilesPictures(std::string path) : path_(std::move(path)) {}

    bool open() override;
    int coarsest() const override { return coarsest_; }
    int finest() const override { return finest_; }
    std::optional<tiles::TilesetFacts::Bounds> bounds() const override { return facts_.bounds; }
    std::string attribution() const override { return facts_.attribution; }
    Answer tile(const tiles::TileKey& key, bool isWanted) override;

  private:
    bool read(std::string& error);

    std::string path_;
    std::shared_ptr<tiles::MbtilesFile> file_;
    std::optional<std::chrono::steady_clock::time_point> looked_;
    std::filesystem::file_time_type written_;
    std::string reported_;
    unsigned version_ = 0;
    tiles::TilesetFacts facts_;
    int coarsest_ = 0;
    int finest_ = 0;
};

}  // namespace ktr::linux_
