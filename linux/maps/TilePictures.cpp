#include "linux/maps/TilePictures.h"

namespace ktr::linux_ {

TilePictures::~TilePictures() = default;

void TilePictures::setChangeHandler(std::function<void()> /*changed*/) {}

}  // namespace ktr::linux_
