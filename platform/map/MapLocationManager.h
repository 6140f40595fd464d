#pragma once

#include <memory>

#include "platform/base/Bundle.h"

namespace ktr::platform {

/// The map framework's own location manager: whose authorisation maps use to show the user. One per installed platform
/// (`shared<MapLocationManager>()`). Main thread.
class KTR_API MapLocationManager : public Object {
  public:
    static std::shared_ptr<MapLocationManager> makeShared() { return std::make_shared<MapLocationManager>(); }
    std::shared_ptr<Bundle> effectiveBundle() const { return effectiveBundle_; }
    void setEffectiveBundle(std::shared_ptr<Bundle> bundle) { effectiveBundle_ = std::move(bundle); }

  private:
    std::shared_ptr<Bundle> effectiveBundle_;
};

}  // namespace ktr::platform
