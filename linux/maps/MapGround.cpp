#include "linux/maps/MapGround.h"

namespace ktr::linux_ {

MapGround::~MapGround() = default;

// By value, as those who fetch keep it.
// NOLINTNEXTLINE(performance-unnecessary-value-param)
void MapGround::setChangeHandler(std::function<void()> /*changed*/) {}

}  // namespace ktr::linux_
