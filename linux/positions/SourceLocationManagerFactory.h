#pragma once

#include <memory>
#include <utility>

#include "linux/positions/SourceLocationManager.h"

namespace ktr::linux_ {

/// Makes managers that share one source. Main thread.
class SourceLocationManagerFactory : public platform::LocationManagerFactory {
  public:
    explicit SourceLocationManagerFactory(std::shared_ptr<PositionHub> hub) : hub_(std::move(hub)) {}
    std::shared_ptr<platform::PlatformLocationManager> makeManager(
        const std::shared_ptr<platform::Bundle>& effectiveBundle) override;

  private:
    std::shared_ptr<PositionHub> hub_;
};

}  // namespace ktr::linux_
