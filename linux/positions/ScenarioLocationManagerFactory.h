#pragma once

#include <memory>
#include <utility>
#include <vector>

#include "linux/positions/ScenarioLocationManager.h"

namespace ktr::linux_ {

/// Makes managers that all follow one walk, which starts when the factory is made. Without positions its managers
/// deliver nothing. Main thread.
class ScenarioLocationManagerFactory : public platform::LocationManagerFactory {
  public:
    /// The positions may come in any order. A position without a timestamp gets the moment at which it becomes known.
    ScenarioLocationManagerFactory(std::vector<TimedPosition> positions, std::shared_ptr<platform::MainLoop> mainLoop,
                                   std::shared_ptr<platform::Clock> clock, std::shared_ptr<platform::Geodesy> geodesy);
    std::shared_ptr<platform::PlatformLocationManager> makeManager(
        const std::shared_ptr<platform::Bundle>& effectiveBundle) override;

  private:
    std::shared_ptr<const Walk> walk_;
};

}  // namespace ktr::linux_
