#include "linux/maps/TilePictures.h"

namespace ktr::linux_ {

TilePictures::~TilePictures() = default;

// As who overrides it keeps it. NOLINTNEXTLINE(performance-unnecessary-value-param)
// By value, as those who fetch keep it.
// NOLINTNEXTLINE(performance-unnecessary-value-param)
void TilePictures::setChangeHandler(std::function<void()> /*changed*/) {}

}  // namespace ktr::linux_
