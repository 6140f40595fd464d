#include "platform/location/Geodesy.h"
#include "platform/location/PlatformLocationManager.h"

namespace ktr::platform {

Geodesy::~Geodesy() = default;
PlatformLocationManagerDelegate::~PlatformLocationManagerDelegate() = default;
LocationManagerFactory::~LocationManagerFactory() = default;

}  // namespace ktr::platform
