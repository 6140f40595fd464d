#include "linux/maps/MapGround.h"

namespace ktr::linux_ {

MapGround::~MapGround() = default;

std::optional<double> MapGround::coarseZoom(const MapDrawing& /*drawing*/) {
    return std::nullopt;
}

// By value, as those who fetch keep it.
// NOLINTNEXTLINE(performance-unnecessary-value-param)
void MapGround::setChangeHandler(std::function<void()> /*changed*/) {}

}  // namespace ktr::linux_
