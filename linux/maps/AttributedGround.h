#pragma once

#include <memory>
#include <string>
#include <utility>

#include "linux/maps/MapGround.h"

namespace ktr::linux_ {

/// Another ground, with words of one's own for whose data it is.
class AttributedGround final : public MapGround {
  public:
    AttributedGround(std::shared_ptr<MapGround> ground, std::string attribution)
        : ground_(std::move(ground)), attribution_(std::move(attribution)) {}

    MapDrawn draw(const MapDrawing& drawing) override {
        MapDrawn drawn = ground_->draw(drawing);
        drawn.attribution = attribution_;
        return drawn;
    }
    void setChangeHandler(std::function<void()> changed) override { ground_->setChangeHandler(std::move(changed)); }

  private:
    std::shared_ptr<MapGround> ground_;
    std::string attribution_;
};

}  // namespace ktr::linux_
