#include "linux/maps/MapGround.h"

namespace ktr::linux_ {

MapGround::~MapGround() = default;

void MapGround::setChangeHandler(std::function<void()> /*changed*/) {}

}  // namespace ktr::linux_
