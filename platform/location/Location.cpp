#include "platform/location/Geodesy.h"
#include "platform/location/PlatformLocationManager.h"

namespace ktr::platform {

Geodesy::~Geodesy() = default;
std::optional<Geodesy::Bounds> Geodesy::distanceBounds(const Coordinate& /*from*/, const Coordinate& /*to*/) const {
    return std::nullopt;
}
PlatformLocationManagerDelegate::~PlatformLocationManagerDelegate() = default;
LocationManagerFactory::~LocationManagerFactory() = default;

}  // namespace ktr::platform
