#pragma once

#include <memory>

#include "linux/configuration/Configuration.h"
#include "platform/base/Clock.h"
#include "platform/base/MainLoop.h"
#include "platform/location/Geodesy.h"
#include "platform/location/PlatformLocationManager.h"

namespace ktr::linux_ {

/// The source of positions that the configuration chooses. Main thread; a track is read from the disk.
class ConfiguredPositions {
  public:
    /// Never none: with the source "none", and with a track that cannot be read (which is logged), the managers deliver
    /// nothing. A track begins now.
    static std::shared_ptr<platform::LocationManagerFactory> make(const Configuration::Positions& configuration,
                                                                  const std::shared_ptr<platform::MainLoop>& mainLoop,
                                                                  const std::shared_ptr<platform::Clock>& clock,
                                                                  const std::shared_ptr<platform::Geodesy>& geodesy);
};

}  // namespace ktr::linux_
