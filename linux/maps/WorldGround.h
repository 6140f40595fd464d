#pragma once

#include <filesystem>
#include <memory>

#include "linux/maps/MapGround.h"
#include "linux/maps/WorldMap.h"

namespace ktr::linux_ {

/// The map that is always there: the world's land and water, borders, countries and towns. It draws everywhere and at
/// every zoom; where its data ends it shows plain land or water. A file that cannot be read is a line in the log, and
/// plain land.
class WorldGround final : public MapGround {
  public:
    static constexpr const char* kAttribution = "Natural Earth";

    /// The file is read when the first picture is drawn.
    explicit WorldGround(std::filesystem::path file) : file_(std::move(file)) {}
    MapDrawn draw(const MapDrawing& drawing) override;
    bool isCoarse() const override { return true; }
    std::optional<double> coarseZoom(const MapDrawing& drawing) override;

  private:
    void read();
    std::filesystem::path file_;
    bool isRead_ = false;
    std::shared_ptr<const WorldMap> map_;
};

}  // namespace ktr::linux_
