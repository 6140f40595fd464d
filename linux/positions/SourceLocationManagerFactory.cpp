#include "linux/positions/SourceLocationManagerFactory.h"

namespace ktr::linux_ {

// GeoClue knows this program by its desktop file, gpsd does not ask: the bundle adds nothing.
std::shared_ptr<platform::PlatformLocationManager> SourceLocationManagerFactory::makeManager(
    const std::shared_ptr<platform::Bundle>&) {
    return std::make_shared<SourceLocationManager>(hub_);
}

}  // namespace ktr::linux_
