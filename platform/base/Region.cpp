#include "platform/base/Region.h"

namespace ktr::platform {

RegionSettings::~RegionSettings() = default;
NumberFormatter::~NumberFormatter() = default;

}  // namespace ktr::platform
